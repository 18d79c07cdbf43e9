#include "lumen/interprocess/vna_message_marshaling.h"

#include <gtest/gtest.h>

#include <thread>

#include "lumen/interprocess/vna_message_error.h"
#include "lumen/interprocess/vna_message_event.h"
#include "lumen/interprocess/vna_message_text.h"
#include "stimulus/golden_bytes.h"

namespace vna_interprocess {
namespace {

using LumenUtility::testutil::Bytes;
using LumenUtility::testutil::Golden;

// A message class the registry does not know.
class UnregisteredMessage : public VNAMessageBase {
 public:
  UnregisteredMessage() : VNAMessageBase(9) {}
};

// Runs first in its own process (ctest runs each test alone), so the two threads race for the
// first construction; ThreadSanitizer checks that the registry is filled once, safely.
TEST(VNAMessageMarshaling, RegistryFillsOnceWhenThreadsConstructTogether) {
  std::vector<unsigned char> blocks[2];
  std::thread threads[2];
  for (int t = 0; t < 2; ++t) {
    threads[t] = std::thread([&blocks, t] {
      VNAMessageMarshaling m(VNAMessageMarshaling::STORE, blocks[t]);
      const VNAMessageText text("hello");
      m.WriteToBuffer(&text);
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_EQ(blocks[0], blocks[1]);
  EXPECT_EQ(VNAMessageMarshaling::sm_vector.size(), 3u);
}

TEST(VNAMessageMarshaling, StoringEmptiesTheBlockAndWritesAtTheCursorDroppingWhatFollows) {
  std::vector<unsigned char> block = {9, 9, 9};
  VNAMessageMarshaling m(VNAMessageMarshaling::STORE, block);
  EXPECT_TRUE(m.IsStoring());
  EXPECT_TRUE(block.empty());
  const unsigned char bytes[] = {1, 2, 3, 4};
  m.WriteToBuffer(bytes, 0);
  EXPECT_TRUE(block.empty());
  m.WriteToBuffer(bytes, 2);
  VNAMessageMarshaling fork(m);  // same vector, same cursor
  m.WriteToBuffer(bytes, 4);
  EXPECT_EQ(block, (Bytes{1, 2, 1, 2, 3, 4}));
  fork.WriteToBuffer(bytes + 3, 1);
  EXPECT_EQ(block, (Bytes{1, 2, 4}));
  EXPECT_EQ(fork.GetPosition(), 3u);

  // Every operation other than STORE reads, and leaves the block as it is.
  for (int op : {1, 2, -1}) {
    Bytes data = {5};
    EXPECT_FALSE(
        VNAMessageMarshaling(static_cast<VNAMessageMarshaling::OPERATION>(op), data).IsStoring());
    EXPECT_EQ(data, Bytes{5});
  }
}

TEST(VNAMessageMarshaling, StringsAreLengthPrefixedAndReadBackInOrder) {
  std::vector<unsigned char> block;
  VNAMessageMarshaling store(VNAMessageMarshaling::STORE, block);
  store.WriteToBuffer(std::string());
  store.WriteToBuffer(std::string("abc"));
  store.WriteToBuffer(std::string("\0z", 2));
  EXPECT_EQ(block, (Bytes{0, 0, 0, 0, 3, 0, 0, 0, 'a', 'b', 'c', 2, 0, 0, 0, 0, 'z'}));

  VNAMessageMarshaling load(VNAMessageMarshaling::LOAD, block);
  std::string s = "old";
  load.ReadFromBuffer(s);
  EXPECT_EQ(s, "");
  EXPECT_EQ(load.GetPosition(), 4u);
  load.ReadFromBuffer(s);
  EXPECT_EQ(s, "abc");
  load.ReadFromBuffer(s);
  EXPECT_EQ(s, std::string("\0z", 2));
  EXPECT_EQ(load.GetPosition(), block.size());
}

TEST(VNAMessageMarshaling, ShortReadsLeaveTheTargetAndTheCursor) {
  std::vector<unsigned char> block = {1, 2, 3};
  VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, block);
  unsigned char value[4] = {7, 7, 7, 7};
  m.ReadFromBuffer(value, 4);
  EXPECT_EQ(Bytes(value, value + 4), (Bytes{7, 7, 7, 7}));
  std::string s = "old";
  m.ReadFromBuffer(s);
  EXPECT_EQ(s, "");
  EXPECT_EQ(m.GetPosition(), 0u);
  m.ReadFromBuffer(value, 3);
  EXPECT_EQ(Bytes(value, value + 4), (Bytes{1, 2, 3, 7}));
  m.ReadFromBuffer(value, 1);  // nothing left
  EXPECT_EQ(m.GetPosition(), 3u);

  // A length beyond the bytes after it: the string stays empty and nothing is consumed.
  for (std::uint32_t length : {4u, 0x7FFFFFFFu, 0xFFFFFFFFu}) {
    std::vector<unsigned char> lying = Golden().Put(length).Append({'a', 'b', 'c'}).bytes;
    VNAMessageMarshaling reader(VNAMessageMarshaling::LOAD, lying);
    s = "old";
    reader.ReadFromBuffer(s);
    EXPECT_EQ(s, "");
    EXPECT_EQ(reader.GetPosition(), 0u) << length;
  }
}

TEST(VNAMessageMarshaling, ObjectIndicesOutsideTheRegistryConsumeFourBytesAndGiveNothing) {
  for (std::int32_t index : {3, 7, -1, 0x7FFFFFFF}) {
    std::vector<unsigned char> block = Golden().Put(index).Put<std::int16_t>(2).bytes;
    VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, block);
    boost::shared_ptr<VNAMarshalObject> p(new VNAMessageText("held"));
    m.ReadFromBuffer(p);
    EXPECT_FALSE(p) << index;
    EXPECT_EQ(m.GetPosition(), 4u);
  }
  std::vector<unsigned char> shortBlock = {0, 0, 0};
  VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, shortBlock);
  boost::shared_ptr<VNAMarshalObject> p(new VNAMessageText("held"));
  m.ReadFromBuffer(p);
  EXPECT_FALSE(p);
  EXPECT_EQ(m.GetPosition(), 0u);
}

TEST(VNAMessageMarshaling, UnregisteredClassesAndNullWriteNothing) {
  std::vector<unsigned char> block;
  VNAMessageMarshaling m(VNAMessageMarshaling::STORE, block);
  const UnregisteredMessage unknown;
  m.WriteToBuffer(&unknown);
  m.WriteToBuffer(static_cast<const VNAMarshalObject*>(nullptr));
  EXPECT_TRUE(block.empty());
  EXPECT_EQ(m.GetPosition(), 0u);
}

}  // namespace
}  // namespace vna_interprocess
