// The message classes the registry knows, in the order of their type indices on the wire.
#include <typeinfo>

#include "lumen/interprocess/vna_message_error.h"
#include "lumen/interprocess/vna_message_event.h"
#include "lumen/interprocess/vna_message_marshaling.h"
#include "lumen/interprocess/vna_message_text.h"

namespace vna_interprocess {

namespace {

template <typename Message>
std::string NameOf() {
  return typeid(Message).name();
}

template <typename Message>
VNAMarshalObject* Create(VNAMessageMarshaling& m) {
  return new Message(m);
}

}  // namespace

VNAMessageMarshaling::FACTORY_ENTRY VNAMessageMarshaling::sm_entries[] = {
    {0, &NameOf<VNAMessageEvent>, &Create<VNAMessageEvent>},
    {1, &NameOf<VNAMessageError>, &Create<VNAMessageError>},
    {2, &NameOf<VNAMessageText>, &Create<VNAMessageText>},
    {-1, nullptr, nullptr},
};

}  // namespace vna_interprocess
