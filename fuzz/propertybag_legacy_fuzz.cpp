// Hands the input to a property bag as a legacy block: every payload an item receives must lie
// inside the block (ASan reports a read past it) and no record may be handed over twice.
#include <cstddef>
#include <cstdint>

#include <boost/make_shared.hpp>

#include "lumen/propertybag.h"
#include "propertybag/test_items.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  using LumenUtility::testutil::RecordingItem;
  LumenUtility::PropertyBag bag;
  const auto power = boost::make_shared<RecordingItem>();
  const auto empty = boost::make_shared<RecordingItem>();
  bag.AddItem("Power", power);
  bag.AddItem("", empty);
  bag.LegacyRecallContext(data, static_cast<int>(size));
  // Each record takes its payload, a zero byte and a 4-byte length.
  std::size_t handed = 0;
  for (const auto* item : {power.get(), empty.get()}) {
    for (const auto& payload : item->legacy) handed += payload.size() + 5;
  }
  if (handed > size) __builtin_trap();
  return 0;
}
