// Reads the input as a message block: objects only, or strings and objects in turn (first
// byte's low bit). Each message read is written and read again, and written once more: the
// two writes must give the same bytes.
#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "lumen/interprocess.h"

namespace {

using vna_interprocess::VNAMarshalObject;
using vna_interprocess::VNAMessageMarshaling;

std::vector<unsigned char> Written(const VNAMarshalObject& message) {
  std::vector<unsigned char> block;
  VNAMessageMarshaling m(VNAMessageMarshaling::STORE, block);
  m.WriteToBuffer(&message);
  return block;
}

void CheckRewrite(const VNAMarshalObject& message) {
  std::vector<unsigned char> first = Written(message);
  VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, first);
  boost::shared_ptr<VNAMarshalObject> again;
  m.ReadFromBuffer(again);
  if (!again || m.GetPosition() != first.size()) __builtin_trap();
  if (Written(*again) != first) __builtin_trap();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  if (size == 0) return 0;
  const bool withStrings = data[0] & 1;
  std::vector<unsigned char> block(data + 1, data + size);
  VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, block);
  for (;;) {
    const std::uint32_t before = m.GetPosition();
    if (withStrings) {
      std::string text;
      m.ReadFromBuffer(text);
    }
    boost::shared_ptr<VNAMarshalObject> message;
    m.ReadFromBuffer(message);
    if (m.GetPosition() > block.size()) __builtin_trap();
    if (message) CheckRewrite(*message);
    if (m.GetPosition() == before) break;
  }
  return 0;
}
