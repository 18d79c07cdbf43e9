#include "lumen/capture/data_capture.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <boost/make_shared.hpp>
#include <string>
#include <vector>

#include "capture/shm_test_util.h"
#include "lumen/capture/file_mapping_reader.h"
#include "lumen/data/data_matrix.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

namespace LumenUtility {
namespace {

using testutil::BlockNameExists;
using testutil::ThrownCode;
using testutil::UniqueBlockName;

// A measurement of the host: what the service asks for, and what it was asked.
class FakeMeasurement : public Interface::IGetSetData {
 public:
  void GetFormattedData(int kind, int format, std::vector<float>& out) override {
    askedKind = kind;
    askedFormat = format;
    out = formatted;
  }
  int GetFormat() override { return format; }
  boost::shared_ptr<DataMatrix> GetCalData() override { return cal; }
  void GetComplexData(const std::vector<TsComplex>*& out) override {
    out = hasComplex ? &complex : nullptr;
  }

  int format = 1;
  std::vector<float> formatted;
  boost::shared_ptr<DataMatrix> cal;
  std::vector<TsComplex> complex;
  bool hasComplex = true;
  int askedKind = -1;
  int askedFormat = -1;
};

constexpr float kUntouched = -7.0f;

// A service per test, its measurements registered under category 1, and nothing left in the
// shared-memory namespace afterwards.
class DataCaptureTest : public ::testing::Test {
 protected:
  void SetUp() override {
    DataCapture::Create();
    DataCapture::Instance().Initialize();
  }
  void TearDown() override {
    DataCapture::Destroy();
    for (FakeMeasurement& m : m_measurements)
      RemoveHostObject<Interface::IGetSetData>(kHostCategoryMeasurement, &m);
    for (const std::wstring& name : m_names) EXPECT_FALSE(BlockNameExists(name));
  }

  DataCapture& Service() { return DataCapture::Instance(); }

  // Measurement `number` (1 to 3) as the host would register it.
  FakeMeasurement& Measurement(int number) {
    RegisterHostObject<Interface::IGetSetData>(kHostCategoryMeasurement, number,
                                               &m_measurements[number - 1]);
    return m_measurements[number - 1];
  }

  // Commits the pending requests under a fresh name and fills the block with kUntouched.
  std::wstring Commit(const std::string& tag) {
    const std::wstring name = UniqueBlockName(tag);
    m_names.push_back(name);
    const std::uint32_t floats = Service().ComputeSizeOfPending();
    Service().CommitDataRequest(name);
    FileMappingWithView<float> view(name, floats);
    for (std::uint32_t k = 0; k < floats; ++k) *view.GetPtr(k) = kUntouched;
    return name;
  }

  static std::vector<float> Floats(const std::wstring& name) {
    const FileMappingReader reader(name);
    return std::vector<float>(reader.GetPtr(0), reader.GetPtr(reader.GetCount()));
  }

  FakeMeasurement m_measurements[3];
  std::vector<std::wstring> m_names;
};

TEST_F(DataCaptureTest, RegionsFollowEachOtherInRequestOrder) {
  EXPECT_EQ(Service().ComputeSizeOfPending(), 0u);
  EXPECT_EQ(Service().AddRequest(L"1:1:SDATA:10"), 0u);
  EXPECT_EQ(Service().AddRequest(L"1:2:FDATA:5"), 20u);
  EXPECT_EQ(Service().ComputeSizeOfPending(), 25u);
  EXPECT_EQ(Service().AddRequest(2, 1, true, 3), 25u);
  EXPECT_EQ(Service().AddRequest(2, 1, false, 3), 31u);
  EXPECT_EQ(Service().ComputeSizeOfPending(), 34u);
  const std::wstring name = Commit("offsets");
  EXPECT_EQ(Service().GetLastSize(), 136u);
  EXPECT_EQ(Floats(name).size(), 34u);
  EXPECT_EQ(DataCapture::Catalog(), std::vector<std::wstring>{name});
  EXPECT_EQ(Service().ComputeSizeOfPending(), 0u);
}

TEST_F(DataCaptureTest, StateAndNameErrorsCarryTheirCodes) {
  DataCapture::Destroy();
  EXPECT_EQ(ThrownCode([] { DataCapture::Instance(); }), LUMEN_E_CAPTURE_STATE);
  EXPECT_TRUE(DataCapture::Catalog().empty());
  DataCapture::ChannelDataDone(1);  // no service: nothing happens
  const float data[2] = {1, 2};
  DataCapture::ChannelIRDone(1, 1, 1, data);
  DataCapture::Preset();

  DataCapture::Create();
  EXPECT_EQ(ThrownCode([&] { Service().AddRequest(L"1:1:FDATA:1"); }), LUMEN_E_CAPTURE_STATE);
  EXPECT_EQ(ThrownCode([&] { Service().AddRequest(1, 1, false, 1); }), LUMEN_E_CAPTURE_STATE);
  Service().Initialize();
  Service().AddRequest(L"1:1:FDATA:4");
  EXPECT_EQ(ThrownCode([&] { Service().CommitDataRequest(L""); }), LUMEN_E_CAPTURE_NO_NAME);
  const std::wstring name = Commit("state");
  EXPECT_EQ(Service().GetLastSize(), 16u);
  EXPECT_EQ(ThrownCode([&] { Service().AddRequest(L"1:1:FDATA:1"); }), LUMEN_E_CAPTURE_STATE);
  EXPECT_EQ(ThrownCode([&] { Service().Delete(UniqueBlockName("never")); }),
            LUMEN_E_CAPTURE_NO_BLOCK);

  // Committing nothing fails before the block of that name is touched.
  EXPECT_EQ(ThrownCode([&] { Service().CommitDataRequest(name); }), E_INVALIDARG);
  EXPECT_EQ(Service().GetLastSize(), 0u);
  EXPECT_EQ(DataCapture::Catalog(), std::vector<std::wstring>{name});
  Measurement(1).formatted = {1, 2, 3, 4};
  DataCapture::ChannelDataDone(1);
  EXPECT_EQ(Floats(name), (std::vector<float>{1, 2, 3, 4}));

  // A malformed request or a failing block changes nothing pending.
  Service().Initialize();
  Service().AddRequest(L"1:1:FDATA:2");
  EXPECT_EQ(ThrownCode([&] { Service().AddRequest(L"1:1:FDATA"); }), E_INVALIDARG);
  EXPECT_EQ(ThrownCode([&] { Service().CommitDataRequest(L"bad/name"); }),
            static_cast<HRESULT>(0x80070016));
  EXPECT_EQ(Service().ComputeSizeOfPending(), 2u);
}

TEST_F(DataCaptureTest, RequestsThatWouldWrapTheBlockAreRefused) {
  EXPECT_EQ(ThrownCode([&] { Service().AddRequest(L"1:1:SDATA:4294967295"); }), E_INVALIDARG);
  EXPECT_EQ(ThrownCode([&] { Service().AddRequest(1, 1, false, kMaxCaptureFloats + 1); }),
            E_INVALIDARG);
  EXPECT_EQ(Service().AddRequest(1, 1, false, kMaxCaptureFloats - 4), 0u);
  EXPECT_EQ(ThrownCode([&] { Service().AddRequest(L"1:1:SDATA:3"); }), E_INVALIDARG);
  EXPECT_EQ(Service().AddRequest(L"1:1:SDATA:2"), kMaxCaptureFloats - 4);
  EXPECT_EQ(Service().ComputeSizeOfPending(), kMaxCaptureFloats);
}

TEST_F(DataCaptureTest, CommittingANameAgainReplacesItsBlockAndRequests) {
  Service().AddRequest(L"1:1:FDATA:4");
  const std::wstring name = Commit("again");
  Service().Initialize();
  Service().AddRequest(L"2:1:FDATA:2");
  Service().CommitDataRequest(name);
  EXPECT_EQ(Service().GetLastSize(), 8u);
  Measurement(1).formatted = {5, 6, 7, 8};
  DataCapture::ChannelDataDone(1);  // the first commit's request went with its block
  EXPECT_EQ(Floats(name), (std::vector<float>{0, 0}));
  DataCapture::ChannelDataDone(2);
  EXPECT_EQ(Floats(name), (std::vector<float>{5, 6}));
}

TEST_F(DataCaptureTest, DeletePresetAndDestroyTakeTheNamesAway) {
  Service().AddRequest(L"1:1:FDATA:2");
  const std::wstring first = Commit("first");
  Service().Initialize();
  Service().AddRequest(L"1:1:FDATA:3");
  const std::wstring second = Commit("second");
  ASSERT_EQ(DataCapture::Catalog().size(), 2u);

  Service().Delete(first);
  EXPECT_FALSE(BlockNameExists(first));
  EXPECT_EQ(DataCapture::Catalog(), std::vector<std::wstring>{second});
  Measurement(1).formatted = {1, 2, 3};
  DataCapture::ChannelDataDone(1);  // the other block's request stays on the channel
  EXPECT_EQ(Floats(second), (std::vector<float>{1, 2, 3}));

  DataCapture::Preset();
  EXPECT_FALSE(BlockNameExists(second));
  EXPECT_TRUE(DataCapture::Catalog().empty());
  EXPECT_EQ(Service().AddRequest(L"1:1:FDATA:1"), 0u);  // Preset opened a request phase
  const std::wstring third = Commit("third");
  DataCapture::Destroy();
  EXPECT_FALSE(BlockNameExists(third));
}

TEST_F(DataCaptureTest, GeneratedNamesCountUpWithTheProcessId) {
  // No other test generates names, so the counter starts here.
  const std::wstring pid = std::to_wstring(getpid());
  EXPECT_EQ(Service().GenerateName(), L"VNASharedMemory_1_" + pid);
  EXPECT_EQ(Service().GenerateName(), L"VNASharedMemory_2_" + pid);
  DataCapture::Destroy();
  DataCapture::Create();
  EXPECT_EQ(Service().GenerateName(), L"VNASharedMemory_3_" + pid);  // process-wide
}

TEST_F(DataCaptureTest, ChannelDataDoneFillsComplexFormattedAndCalibrationRegions) {
  FakeMeasurement& sdata = Measurement(1);
  for (int k = 0; k < 5; ++k) sdata.complex.emplace_back(k + 0.5, -k);
  FakeMeasurement& fdata = Measurement(2);
  fdata.format = 4;
  fdata.formatted = {9, 8};
  FakeMeasurement& cal = Measurement(3);
  cal.cal = boost::make_shared<DataMatrix>(2, std::vector<int>{1, 2}, 3);
  float value = 0;
  for (int j = 0; j < 2; ++j) {
    for (int i = 0; i < 2; ++i) {
      TsComplex* p = (*cal.cal)(i, j).GetPointer();
      for (int k = 0; k < 3; ++k, value += 2) p[k] = TsComplex(value, value + 1);
    }
  }
  Service().AddRequest(L"1:1:SDATA:3");
  Service().AddRequest(L"1:2:FDATA:4");
  Service().AddRequest(L"1:3:CAL:20");
  const std::wstring name = Commit("kinds");
  DataCapture::ChannelDataDone(2);  // another channel
  EXPECT_EQ(Floats(name), std::vector<float>(30, kUntouched));

  DataCapture::ChannelDataDone(1);
  const std::vector<float> floats = Floats(name);
  // Three of the five complex points, as real, imaginary pairs.
  EXPECT_EQ(std::vector<float>(floats.begin(), floats.begin() + 6),
            (std::vector<float>{0.5, 0, 1.5, -1, 2.5, -2}));
  // The formatted trace of kind 2 in the measurement's format, padded with zeros.
  EXPECT_EQ(std::vector<float>(floats.begin() + 6, floats.begin() + 10),
            (std::vector<float>{9, 8, 0, 0}));
  EXPECT_EQ(fdata.askedKind, 2);
  EXPECT_EQ(fdata.askedFormat, 4);
  // The matrix (0,0), (1,0), (0,1) whole, then the first two floats of (1,1). Buffers were
  // numbered in that order above, so the floats count up.
  std::vector<float> expectedCal(20);
  for (int k = 0; k < 20; ++k) expectedCal[k] = static_cast<float>(k);
  EXPECT_EQ(std::vector<float>(floats.begin() + 10, floats.end()), expectedCal);
}

TEST_F(DataCaptureTest, SkippedFormatsAndMissingDataLeaveTheirRegionsAlone) {
  for (int format : {3, 8, 11}) {
    Service().Initialize();
    FakeMeasurement& m = Measurement(1);
    m.format = format;
    m.formatted = {1, 2};
    m.hasComplex = false;
    Service().AddRequest(L"1:1:FDATA:2");
    Service().AddRequest(L"1:1:SDATA:2");  // no complex data
    Service().AddRequest(L"1:1:CAL:2");    // no matrix
    const std::wstring name = Commit("skipped-" + std::to_string(format));
    DataCapture::ChannelDataDone(1);
    EXPECT_EQ(Floats(name), std::vector<float>(8, kUntouched)) << format;
    EXPECT_EQ(m.askedFormat, -1);
  }
}

TEST_F(DataCaptureTest, WalkPassesOverMissingMeasurementsAndEndsAtIncrementalRequests) {
  Measurement(1).formatted = {1, 2};
  Service().AddRequest(L"1:9:FDATA:2");  // no measurement 9
  Service().AddRequest(L"1:1:FDATA:2");
  Service().AddRequest(1, 1, false, 2);  // incremental: the walk ends here
  Service().AddRequest(L"1:1:FDATA:2");
  const std::wstring name = Commit("walk");
  DataCapture::ChannelDataDone(1);
  EXPECT_EQ(Floats(name), (std::vector<float>{kUntouched, kUntouched, 1, 2, kUntouched, kUntouched,
                                              kUntouched, kUntouched}));
}

TEST_F(DataCaptureTest, CalibrationCopyTakesOnlyTheSamplesABufferHas) {
  FakeMeasurement& m = Measurement(1);
  m.cal = boost::make_shared<DataMatrix>(2, std::vector<int>{1, 2}, 2);
  for (int j = 0; j < 2; ++j) {
    for (int i = 0; i < 2; ++i) (*m.cal)(i, j).SetData(std::vector<TsComplex>(2, TsComplex(1, 1)));
  }
  (*m.cal)(1, 0).SetData({TsComplex(5, 6)});                           // shorter than 2
  (*m.cal)(0, 1).SetData(std::vector<TsComplex>(4, TsComplex(3, 3)));  // longer than 2
  Service().AddRequest(L"1:1:CAL:18");  // two floats more than the matrix holds
  const std::wstring name = Commit("cal-lengths");
  DataCapture::ChannelDataDone(1);
  EXPECT_EQ(Floats(name), (std::vector<float>{1, 1, 1, 1, 5, 6, 0, 0, 3, 3, 3, 3, 1, 1, 1, 1,
                                              kUntouched, kUntouched}));
}

TEST_F(DataCaptureTest, CalibrationNeedsASquareMatrixOfPortPairs) {
  FakeMeasurement& m = Measurement(1);
  Service().AddRequest(L"1:1:CAL:4");
  const std::wstring name = Commit("cal-shapes");
  for (const std::vector<std::wstring>& names :
       {std::vector<std::wstring>{L"A", L"B", L"C"},
        std::vector<std::wstring>{L"A", L"B", L"C", L"D"}, std::vector<std::wstring>{}}) {
    m.cal = boost::make_shared<DataMatrix>(names, 2);
    DataCapture::ChannelDataDone(1);
    EXPECT_EQ(Floats(name), std::vector<float>(4, kUntouched)) << names.size();
  }
  m.cal = boost::make_shared<DataMatrix>(std::vector<std::wstring>{L"only"}, 2);
  m.cal->GetDataByName(L"only")[1] = TsComplex(2, 3);
  DataCapture::ChannelDataDone(1);  // a single buffer is a 1 x 1 matrix whatever its name
  EXPECT_EQ(Floats(name), (std::vector<float>{0, 0, 2, 3}));
}

TEST_F(DataCaptureTest, IncrementalDataAppendsAndNeverPassesItsRegion) {
  Service().AddRequest(1, 1, true, 6);   // 12 floats
  Service().AddRequest(1, 2, false, 2);  // the neighbour, another measurement
  Service().AddRequest(L"1:1:FDATA:3");  // same measurement: filled piece by piece too
  const std::wstring name = Commit("incremental");
  const float data[18] = {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16, 17};
  for (int call = 0; call < 3; ++call) DataCapture::ChannelIRDone(1, 1, 3, data + 6 * call);
  DataCapture::ChannelIRDone(2, 1, 3, data);  // no requests on channel 2
  DataCapture::ChannelIRDone(1, 1, 3, nullptr);
  // The third call found the complex region full; the formatted request took 3 floats of
  // each call until its 3 were full.
  EXPECT_EQ(Floats(name), (std::vector<float>{0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, kUntouched,
                                              kUntouched, 0, 1, 2}));

  const float neighbour[4] = {20, 21, 22, 23};
  DataCapture::ChannelIRDone(1, 2, 4, neighbour);  // 4 floats into a region of 2
  const std::vector<float> after = Floats(name);
  EXPECT_EQ(std::vector<float>(after.begin() + 12, after.begin() + 15),
            (std::vector<float>{20, 21, 0}));
}

}  // namespace
}  // namespace LumenUtility
