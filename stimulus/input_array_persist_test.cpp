#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <string>

#include "lumen/platform/archive.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/platform/mem_file.h"
#include "lumen/stimulus/archive.h"
#include "lumen/stimulus/input_array.h"
#include "stimulus/golden_bytes.h"

namespace LumenUtility {
namespace {

using testutil::Bytes;
using testutil::Golden;

enum class Form { kPacked, kArchive, kMfc };

Bytes Save(Form form, InputArray a) {
  Bytes bytes;
  switch (form) {
    case Form::kPacked:
      bytes.resize(a.SaveData(nullptr, 0));
      EXPECT_EQ(a.SaveData(bytes.data(), static_cast<int>(bytes.size())), bytes.size());
      break;
    case Form::kArchive: {
      Archive ar(bytes, false);
      a.Serialize(ar);
      break;
    }
    case Form::kMfc: {
      CMemFile file;
      CArchive ar(&file, CArchive::store);
      ar << a;
      ar.Close();
      bytes = file.Detach();
      break;
    }
  }
  return bytes;
}

// Recalls `bytes` into `target`. The bytes sit in a block of exactly their size, so that a
// read past them is a sanitizer finding.
void Recall(Form form, const Bytes& bytes, InputArray& target) {
  const std::size_t size = bytes.size();
  std::unique_ptr<unsigned char[]> exact(new unsigned char[size ? size : 1]);
  if (size) std::memcpy(exact.get(), bytes.data(), size);
  switch (form) {
    case Form::kPacked:
      target.RecallData(exact.get(), static_cast<int>(size));
      break;
    case Form::kArchive: {
      Bytes buffer(exact.get(), exact.get() + size);
      Archive ar(buffer, true);
      target.Serialize(ar);
      break;
    }
    case Form::kMfc: {
      CMemFile file(exact.get(), size);
      CArchive ar(&file, CArchive::load);
      ar >> target;
      break;
    }
  }
}

// LIN 1..10 (10 points) and ARB 11, 12.
InputArray LinearThenArbitrary() {
  InputArray a(1, 10, 10, Linear);
  a.push_back(Segment(std::vector<double>{11, 12}));
  return a;
}

Bytes PackedSegment(int size, double start, double stop, unsigned n, int type) {
  return Golden().Put(size).Put(1).Put(start).Put(stop).Put(n).Put(type).bytes;
}

Bytes ArchivedSegment(double start, double stop, unsigned n, std::uint8_t type) {
  return Golden().Put<std::uint16_t>(1).Put(start).Put(stop).Put(n).Put(type).bytes;
}

TEST(InputArrayPersist, PackedGoldenBytes) {
  const Bytes expected = Golden()
                             .Put(100)
                             .Put(1)
                             .Put(12u)
                             .Put(2u)
                             .Put(80)
                             .Append(PackedSegment(32, 1, 10, 10, Linear))
                             .Append(PackedSegment(48, 0, 0, 2, Arbitrary))
                             .Put(11.0)
                             .Put(12.0)
                             .bytes;
  EXPECT_EQ(Save(Form::kPacked, LinearThenArbitrary()), expected);
  EXPECT_EQ(Save(Form::kPacked, InputArray()), Golden().Put(20).Put(1).Put(0).Put(0).Put(0).bytes);
  Bytes small(99);
  EXPECT_EQ(LinearThenArbitrary().SaveData(small.data(), 99), 0);
}

TEST(InputArrayPersist, ArchiveGoldenBytes) {
  const Bytes expected = Golden()
                             .Put<std::uint16_t>(1)
                             .Put(2u)
                             .Append(ArchivedSegment(1, 10, 10, Linear))
                             .Append(ArchivedSegment(0, 0, 2, Arbitrary))
                             .Put(16u)
                             .Put(11.0)
                             .Put(12.0)
                             .bytes;
  EXPECT_EQ(Save(Form::kArchive, LinearThenArbitrary()), expected);
  EXPECT_EQ(Save(Form::kArchive, InputArray()), Golden().Put<std::uint16_t>(1).Put(0u).bytes);
}

TEST(InputArrayPersist, MfcGoldenBytesWriteTheWholeSharedVectorWithTheOffset) {
  auto expected = [](const Bytes& arbitraryTail) {
    return Golden()
        .Put(1)
        .Put(12)
        .Put(2)
        .Put(1)
        .Put(1.0)
        .Put(10.0)
        .Put(10)
        .Put(0)
        .Put(1)
        .Put(0.0)
        .Put(0.0)
        .Put(2)
        .Put(3)
        .Append(arbitraryTail)
        .bytes;
  };
  EXPECT_EQ(Save(Form::kMfc, LinearThenArbitrary()),
            expected(Golden().Put(2).Put(11.0).Put(12.0).Put(0).bytes));
  InputArray flattened = LinearThenArbitrary();
  flattened.GetRawArray();  // the arbitrary segment now views points 10 and 11 of 12
  Golden shared;
  shared.Put(12);
  for (int i = 1; i <= 12; ++i) shared.Put(static_cast<double>(i));
  const Bytes bytes = Save(Form::kMfc, flattened);
  EXPECT_EQ(bytes, expected(shared.Put(10).bytes));

  InputArray back;
  Recall(Form::kMfc, bytes, back);  // each arbitrary segment gets its own copy and offset
  EXPECT_EQ(back.GetSegments()[1].GetArray(), (std::vector<double>{11, 12}));
  EXPECT_EQ(Save(Form::kMfc, back), bytes);
  EXPECT_EQ(Save(Form::kMfc, InputArray()), Golden().Put(1).Put(0).bytes);
}

TEST(InputArrayPersist, EveryFormRoundTrips) {
  InputArray flattened = LinearThenArbitrary();
  flattened.push_back(Segment(1e6, 1e9, 11, Log));
  flattened.push_back(Segment(-7.5, 3));
  flattened.GetRawArray();
  for (Form form : {Form::kPacked, Form::kArchive, Form::kMfc}) {
    for (const InputArray& a : {InputArray(), LinearThenArbitrary(), flattened}) {
      InputArray back(42.0, 3);
      back.GetRawArray();  // a stale flattened cache must not survive the recall
      Recall(form, Save(form, a), back);
      EXPECT_EQ(back.size(), a.size());
      EXPECT_EQ(back.NumSegments(), a.NumSegments());
      EXPECT_EQ(back.GetArray(), a.GetArray());
      EXPECT_EQ(std::vector<double>(back.GetRawArray(), back.GetRawArray() + back.size()),
                a.GetArray());
    }
  }
}

TEST(InputArrayPersist, MfcOperatorsFollowTheArchivesMode) {
  CMemFile file;
  CArchive storing(&file, CArchive::store);
  InputArray a = LinearThenArbitrary();
  storing >> a;  // writes, because the archive is storing
  storing.Close();
  EXPECT_EQ(file.GetData(), Save(Form::kMfc, a));
}

TEST(InputArrayPersist, PackedVersionBelowOneChangesNothingAndZeroTotalEmpties) {
  Bytes bytes = Save(Form::kPacked, LinearThenArbitrary());
  bytes[4] = 0;
  InputArray a(3.0, 2);
  EXPECT_EQ(a.RecallData(bytes.data(), static_cast<int>(bytes.size())), 100);
  EXPECT_EQ(a, InputArray(3.0, 2));
  bytes[4] = 1;
  std::memset(bytes.data() + 8, 0, 4);  // total count 0: no segments, whatever follows
  EXPECT_EQ(a.RecallData(bytes.data(), static_cast<int>(bytes.size())), 100);
  EXPECT_TRUE(a.empty());
  EXPECT_EQ(a.NumSegments(), 0u);
}

// Reads corrupted copies of a valid record in one form: every failure must be a documented
// error that leaves the target as it was.
class CorruptedRecord : public ::testing::TestWithParam<Form> {
 protected:
  CorruptedRecord() {
    InputArray a = LinearThenArbitrary();
    a.insert(Segment(5.0, 2), 1);
    a.GetRawArray();
    m_valid = Save(GetParam(), a);
  }

  // "" when `bytes` recall, else the error's first message (or "endOfFile" for the archive
  // exception the MFC form passes through).
  std::wstring Outcome(const Bytes& bytes) {
    const InputArray sentinel(-1.0, 4);
    InputArray target = sentinel;
    std::wstring outcome;
    try {
      Recall(GetParam(), bytes, target);
      std::uint64_t sum = 0;
      for (const Segment& s : target.GetSegments()) sum += s.size();
      EXPECT_EQ(sum, target.size());
      return L"";
    } catch (const LumenException& e) {
      EXPECT_TRUE(e.GetCode() == LUMEN_E_BOUNDS || e.GetCode() == LUMEN_E_UNKNOWN_VERSION);
      outcome = e.GetMessage().empty() ? L"(no message)" : e.GetMessage();
    } catch (const CArchiveException& e) {
      EXPECT_EQ(GetParam(), Form::kMfc);
      EXPECT_EQ(e.m_cause, CArchiveException::endOfFile);
      outcome = L"endOfFile";
    }
    EXPECT_EQ(target.NumSegments(), 1u);
    EXPECT_EQ(target, sentinel);
    return outcome;
  }

  Bytes m_valid;
};

TEST_P(CorruptedRecord, EveryTruncationIsRejected) {
  ASSERT_EQ(Outcome(m_valid), L"");
  for (std::size_t length = 0; length < m_valid.size(); ++length) {
    const std::wstring outcome = Outcome(Bytes(m_valid.begin(), m_valid.begin() + length));
    switch (GetParam()) {
      case Form::kPacked:
        EXPECT_EQ(outcome, length < 20 ? L"InputArray packed record: " + std::to_wstring(length) +
                                             L" bytes are fewer than its 20-byte header"
                                       : L"InputArray packed record: record size 132 is not "
                                         L"between 20 and the " +
                                             std::to_wstring(length) + L" bytes there are")
            << length;
        break;
      case Form::kArchive:
        EXPECT_EQ(outcome, L"Archive Exception: Attempt to read beyond end of buffer.") << length;
        break;
      case Form::kMfc:
        EXPECT_EQ(outcome, L"endOfFile") << length;
        break;
    }
  }
}

TEST_P(CorruptedRecord, FlippedBytesAreReadOrRejectedCleanly) {
  int rejected = 0;
  for (std::size_t offset = 0; offset < m_valid.size(); ++offset) {
    for (unsigned char mask : {0xFF, 0x80, 0x01}) {
      Bytes bytes = m_valid;
      bytes[offset] ^= mask;
      rejected += !Outcome(bytes).empty();
    }
  }
  EXPECT_GT(rejected, 0);
}

INSTANTIATE_TEST_SUITE_P(AllForms, CorruptedRecord,
                         ::testing::Values(Form::kPacked, Form::kArchive, Form::kMfc));

// One field of a valid record set to another value, and the error it gives.
struct FieldCase {
  Form form;
  std::size_t offset;
  std::size_t width;  // bytes
  std::int32_t value;
  std::wstring message;
};

class CorruptedField : public ::testing::TestWithParam<FieldCase> {};

TEST_P(CorruptedField, GivesItsError) {
  const FieldCase& c = GetParam();
  Bytes bytes = Save(c.form, LinearThenArbitrary());
  std::memcpy(bytes.data() + c.offset, &c.value, c.width);
  InputArray target(-1.0, 4);
  try {
    Recall(c.form, bytes, target);
    ADD_FAILURE() << "accepted";
  } catch (const LumenException& e) {
    EXPECT_EQ(e.GetMessage(), c.message);
    EXPECT_EQ(e.GetCode(), c.message.empty() ? LUMEN_E_UNKNOWN_VERSION : LUMEN_E_BOUNDS);
  }
  EXPECT_EQ(target, InputArray(-1.0, 4));
}

// Offsets in the packed record of LIN 1..10, ARB 11, 12: header 0-19, the linear segment
// 20-51, the arbitrary one 52-99. In the archive form: header 0-5, segments from 6 and 29.
// In the MFC form: version 0, total 4, count 8, linear segment 12-39, arbitrary 40-91.
INSTANTIATE_TEST_SUITE_P(
    EachCheck, CorruptedField,
    ::testing::Values(
        FieldCase{Form::kPacked, 0, 4, 101,
                  L"InputArray packed record: record size 101 is not "
                  L"between 20 and the 100 bytes there are"},
        FieldCase{Form::kPacked, 16, 4, 81,
                  L"InputArray packed record: segment byte count 81 does "
                  L"not fit record size 100"},
        FieldCase{Form::kPacked, 12, 4, 3,
                  L"InputArray packed record: 3 segments cannot fit in 80 "
                  L"bytes"},
        FieldCase{Form::kPacked, 8, 4, 13,
                  L"InputArray packed record: total point count 13 is not "
                  L"the segments' 12"},
        FieldCase{Form::kPacked, 24, 4, 0, L"Unhandled recall version in InputArray Segment"},
        FieldCase{Form::kPacked, 48, 4, 4,
                  L"InputArray Segment packed record: segment type 4 is "
                  L"not 0 to 3"},
        FieldCase{Form::kPacked, 76, 4, 3,
                  L"InputArray Segment packed record: record size 48 does "
                  L"not hold 56 bytes"},
        FieldCase{Form::kPacked, 52, 4, 40,
                  L"InputArray Segment packed record: record size 40 does "
                  L"not hold 48 bytes"},
        FieldCase{Form::kArchive, 0, 2, 2, L"InputArray version not recognized"},
        FieldCase{Form::kArchive, 6, 2, 3, L"InputArray::Segment serialization failed."},
        FieldCase{Form::kArchive, 51, 1, 7,
                  L"InputArray::Segment archive record: segment type 7 "
                  L"is not 0 to 3"},
        FieldCase{Form::kArchive, 52, 4, 17,
                  L"InputArray::Segment archive record: byte count 17 "
                  L"is not 8 x 2 points"},
        FieldCase{Form::kMfc, 0, 4, 2, L""}, FieldCase{Form::kMfc, 40, 4, 2, L""},
        FieldCase{Form::kMfc, 4, 4, 13,
                  L"InputArray MFC record: total point count 13 is not the "
                  L"segments' 12"},
        FieldCase{Form::kMfc, 8, 4, -1, L"InputArray MFC record: segment count -1"},
        FieldCase{Form::kMfc, 88, 4, 1,
                  L"InputArray MFC record: offset 1 and 2 points pass the 2 "
                  L"stored"},
        FieldCase{Form::kMfc, 64, 4, 5, L"InputArray MFC record: segment type 5 is not 0 to 3"},
        FieldCase{Form::kMfc, 68, 4, -3, L"InputArray MFC record: point vector length -3"}));

}  // namespace
}  // namespace LumenUtility
