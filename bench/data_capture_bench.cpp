// ChannelDataDone of a channel with a 20001-point complex request and a 4x4 calibration
// matrix of 20001 points (2.7 MB per call), timed in turn with a memcpy of the same bytes
// into another shared-memory block. Both blocks are written once before timing, so neither
// loop pays for first-touch page faults.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <boost/make_shared.hpp>
#include <cstring>
#include <string>
#include <vector>

#include "bench_timing.h"
#include "lumen/capture.h"
#include "lumen/data/data_matrix.h"
#include "lumen/util/host_interfaces.h"
#include "lumen/util/host_object.h"

namespace {

using LumenUtility::DataMatrix;
using LumenUtility::TsComplex;

constexpr int kPoints = 20001;
constexpr int kPorts = 4;

class Measurement : public Interface::IGetSetData {
 public:
  void GetFormattedData(int, int, std::vector<float>& out) override { out.clear(); }
  int GetFormat() override { return 1; }
  boost::shared_ptr<DataMatrix> GetCalData() override { return cal; }
  void GetComplexData(const std::vector<TsComplex>*& out) override { out = &points; }

  std::vector<TsComplex> points;
  boost::shared_ptr<DataMatrix> cal;
};

std::wstring BlockName(const char* tag) {
  return L"lumen-bench-" + std::to_wstring(getpid()) + L"-" +
         std::wstring(tag, tag + std::strlen(tag));
}

void BM_ChannelDataDoneComplexAndCalibration(benchmark::State& state) {
  Measurement complexData, calData;
  complexData.points.resize(kPoints);
  for (int k = 0; k < kPoints; ++k) complexData.points[k] = TsComplex(k * 1e-3, -k * 2e-3);
  calData.cal = boost::make_shared<DataMatrix>(kPorts, std::vector<int>{1, 2, 3, 4}, kPoints);
  for (int j = 0; j < kPorts; ++j) {
    for (int i = 0; i < kPorts; ++i) {
      TsComplex* p = (*calData.cal)(i, j).GetPointer();
      for (int k = 0; k < kPoints; ++k) p[k] = TsComplex(i + k * 1e-4, j - k * 1e-4);
    }
  }
  const int category = LumenUtility::kHostCategoryMeasurement;
  LumenUtility::RegisterHostObject<Interface::IGetSetData>(category, 1, &complexData);
  LumenUtility::RegisterHostObject<Interface::IGetSetData>(category, 2, &calData);

  const std::uint32_t calFloats = kPorts * kPorts * 2 * kPoints;
  DataCapture::Create();
  DataCapture& service = DataCapture::Instance();
  service.Initialize();
  service.AddRequest(L"1:1:SDATA:" + std::to_wstring(kPoints));
  service.AddRequest(L"1:2:CAL:" + std::to_wstring(calFloats));
  const std::uint32_t floats = service.ComputeSizeOfPending();
  service.CommitDataRequest(BlockName("capture"));
  DataCapture::ChannelDataDone(1);  // touches every page of the block

  // The baseline: the same bytes, already in one piece, into a block touched once.
  std::vector<float> source(floats);
  FileMappingWithView<float> target(BlockName("memcpy"), floats);
  const std::size_t bytes = std::size_t{floats} * sizeof(float);
  std::memcpy(target.GetPtr(0), source.data(), bytes);

  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [] {},
      [&] { std::memcpy(target.GetPtr(0), source.data(), bytes); },
      [] { DataCapture::ChannelDataDone(1); });

  const double total = static_cast<double>(bytes) * state.iterations();
  state.counters["GB_per_s"] = total / seconds.second / 1e9;
  state.counters["memcpy_GB_per_s"] = total / seconds.first / 1e9;
  state.counters["x_memcpy"] = seconds.second / seconds.first;
  state.SetBytesProcessed(static_cast<std::int64_t>(total));

  DataCapture::Destroy();
  LumenUtility::RemoveHostObject<Interface::IGetSetData>(category, &complexData);
  LumenUtility::RemoveHostObject<Interface::IGetSetData>(category, &calData);
}
BENCHMARK(BM_ChannelDataDoneComplexAndCalibration)->UseManualTime();

}  // namespace
