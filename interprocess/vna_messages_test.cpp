#include <gtest/gtest.h>

#include "lumen/interprocess.h"
#include "stimulus/golden_bytes.h"

namespace vna_interprocess {
namespace {

using LumenUtility::testutil::Bytes;
using LumenUtility::testutil::Golden;

Bytes Marshaled(const VNAMarshalObject& message) {
  std::vector<unsigned char> block;
  VNAMessageMarshaling m(VNAMessageMarshaling::STORE, block);
  m.WriteToBuffer(&message);
  return block;
}

// The messages a reader rebuilds from `block`, reading objects until one comes back empty.
std::vector<boost::shared_ptr<VNAMarshalObject>> Unmarshaled(std::vector<unsigned char>& block) {
  VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, block);
  std::vector<boost::shared_ptr<VNAMarshalObject>> messages;
  for (;;) {
    boost::shared_ptr<VNAMarshalObject> p;
    m.ReadFromBuffer(p);
    if (!p) return messages;
    messages.push_back(p);
  }
}

// Messages are equal when they marshal alike: marshal writes every field, the id included.
bool SameMessage(const VNAMarshalObject& a, const VNAMarshalObject& b) {
  return typeid(a) == typeid(b) && Marshaled(a) == Marshaled(b);
}

TEST(VNAMessages, GoldenBytesOfEachMessage) {
  const Bytes event = Marshaled(VNAMessageEvent(0x01020304, 5, 0xFFFFFFFF));
  EXPECT_EQ(event.size(), 18u);
  EXPECT_EQ(event, Golden()
                       .Put<std::int32_t>(0)
                       .Put<std::int16_t>(2)
                       .Put<std::uint32_t>(0x01020304)
                       .Put<std::uint32_t>(5)
                       .Put<std::uint32_t>(0xFFFFFFFF)
                       .bytes);
  EXPECT_EQ(Marshaled(VNAMessageError(5, 6, 7)),
            (Bytes{1, 0, 0, 0, 3, 0, 5, 0, 0, 0, 6, 0, 0, 0, 7, 0, 0, 0, 0, 0, 0, 0}));
  EXPECT_EQ(
      Marshaled(VNAMessageError(1, 0, 0, L"\u00b0C")),
      (Bytes{1, 0, 0, 0, 3, 0, 1, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 3, 0, 0, 0, 0xC2, 0xB0, 'C'}));
  EXPECT_EQ(Marshaled(VNAMessageText("abc")), (Bytes{2, 0, 0, 0, 4, 0, 3, 0, 0, 0, 'a', 'b', 'c'}));
  EXPECT_EQ(Marshaled(VNAMessageEvent()),
            Golden().Put<std::int32_t>(0).Put<std::int16_t>(2).Append(Bytes(12, 0)).bytes);
}

TEST(VNAMessages, BlocksOfSeveralItemsReadBackInTheWritersOrder) {
  const VNAMessageError error(0xE8080882, 1, 2, L"Port 2 overload");
  const VNAMessageEvent event(40, 41, 42);
  const VNAMessageText text(std::string(300, 't'));

  std::vector<unsigned char> block;
  VNAMessageMarshaling store(VNAMessageMarshaling::STORE, block);
  store.WriteToBuffer(&error);
  store.WriteToBuffer(std::string("between"));
  store.WriteToBuffer(&event);
  store.WriteToBuffer(&text);

  VNAMessageMarshaling load(VNAMessageMarshaling::LOAD, block);
  boost::shared_ptr<VNAMarshalObject> p;
  std::string between;
  load.ReadFromBuffer(p);
  ASSERT_TRUE(p);
  EXPECT_TRUE(SameMessage(*p, error));
  load.ReadFromBuffer(between);
  EXPECT_EQ(between, "between");
  for (const VNAMarshalObject* expected : {static_cast<const VNAMarshalObject*>(&event),
                                           static_cast<const VNAMarshalObject*>(&text)}) {
    load.ReadFromBuffer(p);
    ASSERT_TRUE(p);
    EXPECT_TRUE(SameMessage(*p, *expected));
  }
  EXPECT_EQ(load.GetPosition(), block.size());
}

TEST(VNAMessages, AMessageKeepsItsClassIdWhateverTheDataSays) {
  // Index 0 (an event) with id bytes 3.
  std::vector<unsigned char> block =
      Golden().Put<std::int32_t>(0).Put<std::int16_t>(3).Append(Bytes(12, 0)).bytes;
  const auto messages = Unmarshaled(block);
  ASSERT_EQ(messages.size(), 1u);
  const auto* event = dynamic_cast<const VNAMessageEvent*>(messages[0].get());
  ASSERT_NE(event, nullptr);
  EXPECT_EQ(event->get_id(), 2);

  // Only id 1 takes the id from the data, and only when its 2 bytes are there.
  std::vector<unsigned char> id = Golden().Put<std::int16_t>(-5).bytes;
  VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, id);
  EXPECT_EQ(VNAMessageBase(1, m).get_id(), -5);
  EXPECT_EQ(VNAMessageBase(1, m).get_id(), 1);  // nothing left
  VNAMessageMarshaling again(VNAMessageMarshaling::LOAD, id);
  EXPECT_EQ(VNAMessageBase(7, again).get_id(), 7);
  EXPECT_EQ(again.GetPosition(), 2u);
}

TEST(VNAMessages, ExtraTextIsUtf8AndMalformedBytesReadAsReplacements) {
  VNAMessageError error(1, 2, 3, L"\u00e9 \U0001F4E1");
  EXPECT_EQ(error.get_ExtraText(), "\xC3\xA9 \xF0\x9F\x93\xA1");
  EXPECT_EQ(error.get_ExtraTextAsCString(), L"\u00e9 \U0001F4E1");
  error.set_ExtraText(
      std::string("\xB0"
                  "C"));
  EXPECT_EQ(error.get_ExtraTextAsCString(), L"\uFFFDC");
}

// Reads a valid block of three messages cut short or with flipped bytes: every read stays
// inside the block and yields registered messages only; a cut block yields the whole
// messages before the cut and then at most one whose missing fields are 0 or empty.
class CorruptedMessageBlock : public ::testing::Test {
 protected:
  CorruptedMessageBlock() {
    VNAMessageMarshaling m(VNAMessageMarshaling::STORE, m_valid);
    for (const VNAMarshalObject* message : {static_cast<const VNAMarshalObject*>(&m_event),
                                            static_cast<const VNAMarshalObject*>(&m_error),
                                            static_cast<const VNAMarshalObject*>(&m_text)}) {
      m.WriteToBuffer(message);
    }
  }

  VNAMessageEvent m_event{11, 12, 13};
  VNAMessageError m_error{21, 22, 23, L"twenty"};
  VNAMessageText m_text{"thirty"};
  std::vector<unsigned char> m_valid;
};

TEST_F(CorruptedMessageBlock, ACutBlockGivesTheWholeMessagesBeforeTheCut) {
  // Messages span bytes 0-17 (event), 18-45 (error, its text from 40) and 46-61 (text).
  ASSERT_EQ(m_valid.size(), 62u);
  for (std::size_t length = 0; length <= m_valid.size(); ++length) {
    std::vector<unsigned char> cut(m_valid.begin(), m_valid.begin() + length);
    const auto messages = Unmarshaled(cut);
    const std::size_t whole = (length >= 18) + (length >= 46) + (length >= 62);
    ASSERT_GE(messages.size(), whole) << length;
    ASSERT_LE(messages.size(), whole + 1) << length;
    const VNAMarshalObject* originals[] = {&m_event, &m_error, &m_text};
    for (std::size_t i = 0; i < whole; ++i) {
      EXPECT_TRUE(SameMessage(*messages[i], *originals[i])) << length << " " << i;
    }
    if (messages.size() > whole) {
      const VNAMarshalObject& partial = *messages.back();
      EXPECT_EQ(typeid(partial), typeid(*originals[whole])) << length;
      if (const auto* e = dynamic_cast<const VNAMessageError*>(&partial)) {
        EXPECT_TRUE(e->get_ExtraText().empty()) << length;  // its text is cut
        EXPECT_EQ(e->get_Hint2(), length >= 36 ? 23u : 0u) << length;
      }
    }
  }
}

TEST_F(CorruptedMessageBlock, FlippedBytesGiveRegisteredMessagesOrNothing) {
  for (std::size_t offset = 0; offset < m_valid.size(); ++offset) {
    for (unsigned char mask : {0xFF, 0x80, 0x01}) {
      std::vector<unsigned char> bytes = m_valid;
      bytes[offset] ^= mask;
      const auto messages = Unmarshaled(bytes);
      EXPECT_LE(messages.size(), bytes.size() / 4) << offset;  // each takes its 4-byte index
      for (const auto& p : messages) {
        EXPECT_TRUE(dynamic_cast<const VNAMessageBase*>(p.get())) << offset;
      }
    }
  }
}

}  // namespace
}  // namespace vna_interprocess
