// Marshaling 10,000 interprocess messages (events, errors with a text and text messages in
// turn) into one block, and rebuilding them from it, each timed in turn with a memcpy of the
// block's bytes.
#include <benchmark/benchmark.h>

#include <cstring>
#include <vector>

#include "bench_timing.h"
#include "lumen/interprocess.h"

namespace {

using namespace vna_interprocess;

constexpr int kMessages = 10000;

struct Messages {
  std::vector<VNAMessageEvent> events;
  std::vector<VNAMessageError> errors;
  std::vector<VNAMessageText> texts;
  std::vector<const VNAMarshalObject*> inOrder;
};

Messages MakeMessages() {
  Messages m;
  m.events.reserve(kMessages);
  m.errors.reserve(kMessages);
  m.texts.reserve(kMessages);
  for (int i = 0; i < kMessages; ++i) {
    switch (i % 3) {
      case 0:
        m.events.emplace_back(i, i + 1, i + 2);
        m.inOrder.push_back(&m.events.back());
        break;
      case 1:
        m.errors.emplace_back(0xE8080882, i, 0, L"Receiver overload on port 2");
        m.inOrder.push_back(&m.errors.back());
        break;
      default:
        m.texts.emplace_back("Sweep " + std::to_string(i) + " complete");
        m.inOrder.push_back(&m.texts.back());
        break;
    }
  }
  return m;
}

void Marshal(const Messages& messages, std::vector<unsigned char>& block) {
  VNAMessageMarshaling m(VNAMessageMarshaling::STORE, block);
  for (const VNAMarshalObject* message : messages.inOrder) m.WriteToBuffer(message);
}

// messages_per_s of the operation, and x_memcpy = how many times it is slower than copying
// the block's bytes.
void Report(benchmark::State& state, std::size_t blockBytes,
            const lumen_bench::SecondsInTurn& seconds) {
  const double messages = static_cast<double>(kMessages) * state.iterations();
  state.counters["messages_per_s"] = messages / seconds.second;
  state.counters["x_memcpy"] = seconds.second / seconds.first;
  state.SetBytesProcessed(static_cast<std::int64_t>(blockBytes) * state.iterations());
}

void BM_Marshal10000Messages(benchmark::State& state) {
  const Messages messages = MakeMessages();
  std::vector<unsigned char> block, copy;
  Marshal(messages, block);
  copy.resize(block.size());
  const std::vector<unsigned char> reference = block;
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [] {},
      [&] { std::memcpy(copy.data(), reference.data(), reference.size()); },
      [&] { Marshal(messages, block); });
  if (block != reference) state.SkipWithError("marshaled block differs");
  Report(state, reference.size(), seconds);
}
BENCHMARK(BM_Marshal10000Messages)->UseManualTime();

void BM_Unmarshal10000Messages(benchmark::State& state) {
  std::vector<unsigned char> block;
  Marshal(MakeMessages(), block);
  std::vector<unsigned char> copy(block.size());
  std::vector<boost::shared_ptr<VNAMarshalObject>> rebuilt(kMessages);
  const lumen_bench::SecondsInTurn seconds = lumen_bench::TimeInTurn(
      state, lumen_bench::Reported::kSecond, [] {},
      [&] { std::memcpy(copy.data(), block.data(), block.size()); },
      [&] {
        VNAMessageMarshaling m(VNAMessageMarshaling::LOAD, block);
        for (auto& message : rebuilt) m.ReadFromBuffer(message);
      });
  for (const auto& message : rebuilt) {
    if (!message) state.SkipWithError("a message was not rebuilt");
  }
  Report(state, block.size(), seconds);
}
BENCHMARK(BM_Unmarshal10000Messages)->UseManualTime();

}  // namespace
