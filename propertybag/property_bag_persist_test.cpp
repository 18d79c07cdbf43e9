#include <gtest/gtest.h>

#include <boost/make_shared.hpp>
#include <cstring>
#include <map>
#include <memory>

#include "lumen/platform/archive.h"
#include "lumen/platform/mem_file.h"
#include "lumen/propertybag/property_bag.h"
#include "propertybag/test_items.h"
#include "stimulus/golden_bytes.h"

namespace LumenUtility {
namespace {

using testutil::Bytes;
using testutil::Golden;
using testutil::RecordingItem;
using testutil::SilentItem;

Bytes Saved(PropertyBag& bag) {
  CMemFile file;
  CArchive ar(&file, CArchive::store);
  bag.SaveContext(ar);
  ar.Close();
  return file.Detach();
}

// Recalls `bag` from `bytes`; returns how many bytes were read.
std::uint64_t Recall(PropertyBag& bag, const Bytes& bytes) {
  CMemFile file(bytes);
  CArchive ar(&file, CArchive::load);
  bag.RecallContext(ar);
  return file.GetPosition();
}

// The cause of the CArchiveException that `operation` throws; none when it throws none.
template <typename Operation>
int ArchiveCause(Operation operation) {
  try {
    operation();
  } catch (const CArchiveException& e) {
    return e.m_cause;
  }
  return CArchiveException::none;
}

int RecallCause(PropertyBag& bag, const Bytes& bytes) {
  return ArchiveCause([&] { Recall(bag, bytes); });
}

// A key or text in the archive's tagged wide form, for keys below 255 characters.
Bytes Tagged(const std::string& ascii) {
  Golden g = Golden().Put<std::uint8_t>(0xFF).Put<std::uint16_t>(0xFFFE);
  g.Put(static_cast<std::uint8_t>(ascii.size()));
  for (char c : ascii) g.Put(static_cast<std::uint16_t>(c));
  return g.bytes;
}

// An archive entry of a RecordingItem: its key, value and text.
Bytes Entry(const std::string& key, std::int32_t value, const std::string& text) {
  return Golden().Append(Tagged(key)).Put(value).Append(Tagged(text)).bytes;
}

boost::shared_ptr<RecordingItem> Item(std::int32_t value = 0, std::wstring text = L"") {
  return boost::make_shared<RecordingItem>(value, std::move(text));
}

TEST(PropertyBagPersist, AnEmptyBagIsItsCountAloneAndRecallReadsOnlyThat) {
  PropertyBag empty;
  EXPECT_EQ(Saved(empty), (Bytes{0, 0, 0, 0}));
  EXPECT_EQ(Recall(empty, {0, 0, 0, 0, 0xAA, 0xBB}), 4u);
  // A negative count reads nothing more either.
  EXPECT_EQ(Recall(empty, Golden().Put<std::int32_t>(-1).Append(Entry("a", 1, "")).bytes), 4u);

  // The archive's own direction errors pass through.
  CMemFile file(Bytes{0, 0, 0, 0});
  CArchive loading(&file, CArchive::load);
  EXPECT_EQ(ArchiveCause([&] { empty.SaveContext(loading); }), CArchiveException::readOnly);
  CMemFile out;
  CArchive storing(&out, CArchive::store);
  EXPECT_EQ(ArchiveCause([&] { empty.RecallContext(storing); }), CArchiveException::writeOnly);
}

TEST(PropertyBagPersist, SavedBagGoldenBytesInKeyOrderAndRoundTrip) {
  PropertyBag bag;
  bag.AddItem("b", Item(7));
  bag.AddItem("a", Item(-1, L"x"));
  const Bytes bytes = Saved(bag);
  EXPECT_EQ(bytes, Golden()
                       .Put<std::uint32_t>(2)
                       .Append({0xFF, 0xFE, 0xFF, 0x01, 'a', 0})
                       .Append({0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFE, 0xFF, 0x01, 'x', 0})
                       .Append({0xFF, 0xFE, 0xFF, 0x01, 'b', 0})
                       .Append({0x07, 0, 0, 0, 0xFF, 0xFE, 0xFF, 0x00})
                       .bytes);

  PropertyBag back;
  const auto a = Item(), b = Item(), untouched = Item(5, L"keep");
  back.AddItem("a", a);
  back.AddItem("b", b);
  back.AddItem("c", untouched);
  EXPECT_EQ(Recall(back, bytes), bytes.size());
  EXPECT_EQ(a->value, -1);
  EXPECT_EQ(a->text, L"x");
  EXPECT_EQ(b->value, 7);
  EXPECT_EQ(untouched->value, 5);  // not in the archive: keeps its state
  EXPECT_EQ(untouched->text, L"keep");
}

TEST(PropertyBagPersist, KeysAreWideWithTheNarrowestCountAndMustBeUtf8) {
  PropertyBag bag;
  bag.AddItem(std::string(300, 'k'), Item(1));
  bag.AddItem("\xC3\xA9", Item(2));  // UTF-8 bytes of U+00E9
  Bytes bytes = Saved(bag);
  ASSERT_EQ(bytes.size(), 4 + (6 + 600 + 8) + (6 + 8u));
  EXPECT_EQ(Bytes(bytes.begin() + 4, bytes.begin() + 10),
            (Bytes{0xFF, 0xFE, 0xFF, 0xFF, 0x2C, 0x01}));
  EXPECT_EQ(Bytes(bytes.begin() + 618, bytes.begin() + 624),
            (Bytes{0xFF, 0xFE, 0xFF, 0x01, 0xE9, 0}));

  // Bytes that are not UTF-8 could not be looked up again: nothing is written.
  bag.AddItem(std::string("\xB0") + "C", Item());
  CMemFile file;
  CArchive ar(&file, CArchive::store);
  EXPECT_EQ(ArchiveCause([&] { bag.SaveContext(ar); }), CArchiveException::genericException);
  ar.Close();
  EXPECT_EQ(file.GetLength(), 0u);
}

TEST(PropertyBagPersist, TheTwoPayloadlessKeysAreSkippedWhetherOrNotTheBagHoldsThem) {
  const Bytes bytes = Golden()
                          .Put<std::int32_t>(3)
                          .Append(Tagged("UnguidedIsolationORRIN"))
                          .Append(Entry("Power", 9, "dBm"))
                          .Append(Tagged("OrrinUserCharacterizerPropBagItem"))
                          .bytes;
  for (bool holdsSkipped : {false, true}) {
    PropertyBag bag;
    const auto power = Item();
    const auto silent = boost::make_shared<SilentItem>();
    bag.AddItem("Power", power);
    if (holdsSkipped) bag.AddItem("UnguidedIsolationORRIN", silent);
    EXPECT_EQ(Recall(bag, bytes), bytes.size());
    EXPECT_EQ(power->value, 9);
    EXPECT_EQ(power->text, L"dBm");
    EXPECT_EQ(silent->serialized, 0);
  }
  // The comparison is case-sensitive: another spelling is an unknown key.
  PropertyBag bag;
  EXPECT_EQ(RecallCause(
                bag, Golden().Put<std::int32_t>(1).Append(Tagged("unguidedIsolationORRIN")).bytes),
            CArchiveException::badIndex);
}

TEST(PropertyBagPersist, AnUnknownKeyEndsTheRecallWithBadIndexKeepingWhatWasRestored) {
  PropertyBag bag;
  const auto a = Item(), b = Item();
  bag.AddItem("a", a);
  bag.AddItem("b", b);
  const Bytes bytes = Golden()
                          .Put<std::int32_t>(3)
                          .Append(Entry("a", 1, "one"))
                          .Append(Entry("zz", 2, ""))
                          .Append(Entry("b", 3, ""))
                          .bytes;
  CMemFile file(bytes);
  CArchive ar(&file, CArchive::load);
  try {
    bag.RecallContext(ar);
    ADD_FAILURE() << "recalled";
  } catch (const CArchiveException& e) {
    EXPECT_EQ(e.m_cause, CArchiveException::badIndex);
    EXPECT_EQ(e.m_strFileName, L"");
  }
  EXPECT_EQ(a->value, 1);
  EXPECT_EQ(b->value, 0);
  EXPECT_EQ(file.GetPosition(), 4 + 20 + 8u);  // stopped after the unknown key
}

// Recalls corrupted copies of a valid archive: each must recall, or fail with the archive
// exception for a short archive or an unknown key.
class CorruptedBagArchive : public ::testing::Test {
 protected:
  CorruptedBagArchive() {
    PropertyBag source;
    source.AddItem("Power", Item(-10, L"dBm"));
    source.AddItem("Points", Item(201));
    source.AddItem("UnguidedIsolationORRIN", boost::make_shared<SilentItem>());
    m_valid = Saved(source);
  }

  int Outcome(const Bytes& bytes) {
    PropertyBag target;
    target.AddItem("Power", Item());
    target.AddItem("Points", Item());
    return RecallCause(target, bytes);
  }

  Bytes m_valid;
};

TEST_F(CorruptedBagArchive, EveryTruncationEndsWithEndOfFile) {
  ASSERT_EQ(Outcome(m_valid), CArchiveException::none);
  for (std::size_t length = 0; length < m_valid.size(); ++length) {
    EXPECT_EQ(Outcome(Bytes(m_valid.begin(), m_valid.begin() + length)),
              CArchiveException::endOfFile)
        << length;
  }
}

TEST_F(CorruptedBagArchive, FlippedBytesRecallOrFailWithAnArchiveCause) {
  std::map<int, int> outcomes;
  for (std::size_t offset = 0; offset < m_valid.size(); ++offset) {
    for (unsigned char mask : {0xFF, 0x80, 0x01}) {
      Bytes bytes = m_valid;
      bytes[offset] ^= mask;
      const int cause = Outcome(bytes);
      EXPECT_TRUE(cause == CArchiveException::none || cause == CArchiveException::endOfFile ||
                  cause == CArchiveException::badIndex)
          << offset << " " << int(mask) << " " << cause;
      ++outcomes[cause];
    }
  }
  EXPECT_GT(outcomes[CArchiveException::none], 0);
  EXPECT_GT(outcomes[CArchiveException::endOfFile], 0);
  EXPECT_GT(outcomes[CArchiveException::badIndex], 0);
}

// A legacy record: the key, its zero byte, the 4-byte length, the payload.
Bytes Record(const std::string& key, const Bytes& payload) {
  return Golden()
      .Append(Bytes(key.begin(), key.end()))
      .Put<std::uint8_t>(0)
      .Put(static_cast<std::uint32_t>(payload.size()))
      .Append(payload)
      .bytes;
}

TEST(PropertyBagLegacy, KnownKeysGetTheirPayloadAndUnknownOnesAreSkipped) {
  PropertyBag bag;
  const auto power = Item(), empty = Item();
  bag.AddItem("Power", power);
  bag.AddItem("", empty);
  const Bytes records = Golden()
                            .Append(Record("Power", {1, 2, 3, 4}))
                            .Append(Record("Span", {5, 6}))
                            .Append(Record("", {}))
                            .Append(Record("Power", {7}))
                            .bytes;
  bag.LegacyRecallContext(records.data(), static_cast<int>(records.size()));
  EXPECT_EQ(power->legacy, (std::vector<Bytes>{{1, 2, 3, 4}, {7}}));
  EXPECT_EQ(empty->legacy, std::vector<Bytes>{Bytes{}});  // a zero-length payload is handed over

  const Bytes block = Record("Power", {9});
  bag.LegacyRecallContext(nullptr, 10);
  bag.LegacyRecallContext(block.data(), 0);
  bag.LegacyRecallContext(block.data(), -1);
  EXPECT_EQ(power->legacy.size(), 2u);
}

// A valid legacy block cut short or with its length fields changed: the items get exactly
// the records that lie whole inside the block, and no read goes past it (ASan watches).
class CorruptedLegacyBlock : public ::testing::Test {
 protected:
  CorruptedLegacyBlock()
      : m_valid(Golden()
                    .Append(Record("Power", {1, 2, 3, 4}))
                    .Append(Record("Span", {5, 6}))
                    .Append(Record("Power", {7, 8, 9}))
                    .bytes) {}

  // The payloads the item under "Power" receives from `block`, read from a copy of exactly
  // its size.
  std::vector<Bytes> Received(const Bytes& block) {
    PropertyBag bag;
    const auto power = Item();
    bag.AddItem("Power", power);
    bag.AddItem("Span", Item());
    const auto exact = std::make_unique<unsigned char[]>(block.size());
    if (!block.empty()) std::memcpy(exact.get(), block.data(), block.size());
    bag.LegacyRecallContext(exact.get(), static_cast<int>(block.size()));
    return power->legacy;
  }

  Bytes m_valid;
};

TEST_F(CorruptedLegacyBlock, TruncationsDeliverOnlyWholeRecords) {
  // Records span bytes 0-13 (Power), 14-24 (Span, its length at 19) and 25-37 (Power).
  for (std::size_t length = 0; length <= m_valid.size(); ++length) {
    std::vector<Bytes> expected;
    if (length >= 14) expected.push_back({1, 2, 3, 4});
    if (length >= 38) expected.push_back({7, 8, 9});
    EXPECT_EQ(Received(Bytes(m_valid.begin(), m_valid.begin() + length)), expected) << length;
  }
}

TEST_F(CorruptedLegacyBlock, LengthsBeyondTheBlockOrWithoutTerminatorStopTheRecall) {
  for (std::uint32_t length : {0xFFFFFFFFu, 0x80000000u, 25u}) {
    Bytes bytes = m_valid;
    std::memcpy(bytes.data() + 19, &length, 4);  // the Span record's length
    EXPECT_EQ(Received(bytes), std::vector<Bytes>{Bytes({1, 2, 3, 4})}) << length;
  }
  Bytes unterminated = m_valid;
  std::memset(unterminated.data() + 14, 'x', unterminated.size() - 14);
  EXPECT_EQ(Received(unterminated), std::vector<Bytes>{Bytes({1, 2, 3, 4})});
  for (std::size_t offset = 0; offset < m_valid.size(); ++offset) {
    Bytes bytes = m_valid;
    bytes[offset] ^= 0xFF;
    EXPECT_LE(Received(bytes).size(), 2u);  // never more records than the block holds
  }
}

}  // namespace
}  // namespace LumenUtility
