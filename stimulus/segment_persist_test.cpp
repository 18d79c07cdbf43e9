#include <gtest/gtest.h>

#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/archive.h"
#include "lumen/stimulus/segment.h"
#include "stimulus/golden_bytes.h"

namespace LumenUtility {
namespace {

using testutil::Bytes;
using testutil::Golden;

Bytes Packed(const Segment& s) {
  Bytes bytes(s.SaveData(nullptr, 0));
  EXPECT_EQ(s.SaveData(bytes.data(), static_cast<int>(bytes.size())), bytes.size());
  return bytes;
}

Bytes Archived(Segment s) {
  Bytes bytes;
  Archive ar(bytes, false);
  s.Serialize(ar);
  return bytes;
}

Golden PackedHeader(int size, int version, double start, double stop, unsigned n, int type) {
  return Golden().Put(size).Put(version).Put(start).Put(stop).Put(n).Put(type);
}

TEST(SegmentPersist, PackedRecordSizesFollowTheType) {
  EXPECT_EQ(Segment(1, 10, 10, Linear).SaveData(nullptr, 0), 32);
  const Segment arb(std::vector<double>{1, 2, 3});
  EXPECT_EQ(arb.SaveData(nullptr, 0), 56);
  Bytes small(40, 0xCC);
  EXPECT_EQ(arb.SaveData(small.data(), 40), 0);
  EXPECT_EQ(small, Bytes(40, 0xCC));  // nothing written
}

TEST(SegmentPersist, PackedGoldenBytesAndRoundTrips) {
  EXPECT_EQ(Packed(Segment(1e6, 2e9, 201, Log)), PackedHeader(32, 1, 1e6, 2e9, 201, Log).bytes);
  EXPECT_EQ(Packed(Segment(std::vector<double>{11, 12})),
            PackedHeader(48, 1, 0, 0, 2, Arbitrary).Put(11.0).Put(12.0).bytes);
  for (const Segment& s :
       {Segment(1e6, 2e9, 201, Log), Segment(-3.0, 4), Segment(std::vector<double>{5, -1, 7}),
        Segment(std::vector<double>{})}) {
    Segment back;
    const Bytes bytes = Packed(s);
    EXPECT_EQ(back.RecallData(bytes.data(), static_cast<int>(bytes.size())), bytes.size());
    EXPECT_EQ(back, s);
    EXPECT_EQ(back.GetType(), s.GetType());
  }
}

TEST(SegmentPersist, PackedVersionsAboveOneReadAsOneAndZeroIsRefused) {
  Bytes newer = PackedHeader(40, 2, 1, 5, 5, Linear).Put(0.0).bytes;  // 8 extra bytes
  Segment s;
  EXPECT_EQ(s.RecallData(newer.data(), static_cast<int>(newer.size())), 40);
  EXPECT_EQ(s, Segment(1, 5, 5, Linear));
  const Bytes old = PackedHeader(32, 0, 1, 5, 5, Linear).bytes;
  try {
    s.RecallData(old.data(), 32);
    ADD_FAILURE();
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetCode(), LUMEN_E_BOUNDS);
    EXPECT_EQ(e.GetMessage(), L"Unhandled recall version in InputArray Segment");
  }
  EXPECT_EQ(s, Segment(1, 5, 5, Linear));
}

TEST(SegmentPersist, ArchiveGoldenBytesAndRoundTrips) {
  const Bytes fixed = Archived(Segment(3.5, 5));
  EXPECT_EQ(fixed.size(), 23u);
  EXPECT_EQ(fixed, Golden()
                       .Put<std::uint16_t>(1)
                       .Put(3.5)
                       .Put(3.5)
                       .Put<std::uint32_t>(5)
                       .Put<std::uint8_t>(Fixed)
                       .bytes);
  EXPECT_EQ(Archived(Segment(std::vector<double>{1, 2})), Golden()
                                                              .Put<std::uint16_t>(1)
                                                              .Put(0.0)
                                                              .Put(0.0)
                                                              .Put<std::uint32_t>(2)
                                                              .Put<std::uint8_t>(Arbitrary)
                                                              .Put<std::uint32_t>(16)
                                                              .Put(1.0)
                                                              .Put(2.0)
                                                              .bytes);
  for (const Segment& s : {Segment(1, 10, 10, Linear), Segment(std::vector<double>{9, 8})}) {
    Bytes bytes = Archived(s);
    Archive ar(bytes, true);
    Segment back;
    back.Serialize(ar);
    EXPECT_EQ(back, s);
  }
}

TEST(SegmentPersist, ArchiveRejectsBadVersionTypeAndByteCount) {
  struct Case {
    std::size_t offset;
    unsigned char value;
    std::wstring message;
  } cases[] = {
      {0, 2, L"InputArray::Segment serialization failed."},
      {22, 4, L"InputArray::Segment archive record: segment type 4 is not 0 to 3"},
      {23, 17, L"InputArray::Segment archive record: byte count 17 is not 8 x 2 points"},
  };
  for (const Case& c : cases) {
    Bytes bytes = Archived(Segment(std::vector<double>{1, 2}));
    bytes[c.offset] = c.value;
    Archive ar(bytes, true);
    Segment s(7.0, 1);
    try {
      s.Serialize(ar);
      ADD_FAILURE() << c.offset;
    } catch (const LumenException& e) {
      EXPECT_EQ(e.GetMessage(), c.message);
    }
    EXPECT_EQ(s, Segment(7.0, 1));
  }
}

}  // namespace
}  // namespace LumenUtility
