#include "lumen/phase/pa_parameter_record.h"

PAParameterRecord::PAParameterRecord(const PAParameterRecord& other)
    : values(other.values),
      count(other.count.load(std::memory_order_acquire)),
      begin(other.begin),
      phasorSum(other.phasorSum),
      spill(other.spill) {}

PAParameterRecord& PAParameterRecord::operator=(const PAParameterRecord& other) {
  if (this == &other) return *this;
  values = other.values;
  count.store(other.count.load(std::memory_order_acquire), std::memory_order_release);
  begin = other.begin;
  phasorSum = other.phasorSum;
  spill = other.spill;
  return *this;
}
