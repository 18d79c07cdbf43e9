// Interprocess messages: an error message written into a byte block and read back as a new
// object of its registered class.
// guide:begin
#include <boost/shared_ptr.hpp>
#include <cstdio>
#include <vector>

#include "lumen/interprocess.h"

using namespace vna_interprocess;

int main() {
  std::vector<unsigned char> block;
  {
    VNAMessageError error(0xE8060651u, 3, 7);
    error.set_ExtraText("port 2 overload");
    VNAMessageMarshaling writer(VNAMessageMarshaling::STORE, block);
    writer.WriteToBuffer(&error);  // type index, message id, fields
  }
  std::printf("%zu bytes\n", block.size());

  VNAMessageMarshaling reader(VNAMessageMarshaling::LOAD, block);
  boost::shared_ptr<VNAMarshalObject> message;
  reader.ReadFromBuffer(message);
  if (auto* error = dynamic_cast<VNAMessageError*>(message.get())) {
    std::printf("error 0x%08X, hints %u %u, \"%s\"\n", error->get_Error(), error->get_Hint1(),
                error->get_Hint2(), error->get_ExtraText().c_str());
  }

  std::vector<unsigned char> truncated(block.begin(), block.begin() + 2);
  VNAMessageMarshaling shortReader(VNAMessageMarshaling::LOAD, truncated);
  shortReader.ReadFromBuffer(message);
  std::printf("from 2 bytes: %s\n", message ? "a message" : "nothing");
}
// guide:end
