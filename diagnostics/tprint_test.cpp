#include <gtest/gtest.h>

#include <boost/property_tree/json_parser.hpp>
#include <boost/property_tree/ptree.hpp>
#include <atomic>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include "diagnostics/etw_logging.h"
#include "lumen/diagnostics/event_tracing.h"
#include "lumen/platform/json_trace_file_sink.h"
#include "lumen/platform/memory_trace_sink.h"
#include "lumen/platform/text_conversion.h"
#include "platform/temp_dir.h"
#include "platform/trace_test_bytes.h"

namespace {

using namespace LumenUtility;
using LumenUtility::testutil::Int32Bytes;
using LumenUtility::testutil::TextBytes;

// Every test starts and ends without a tracing object.
class TPrintTest : public testing::Test {
 protected:
  void SetUp() override { ETWReset(); }
  void TearDown() override { ETWReset(); }
  // Tracing object, TPrint on, and a session taking every event into m_sink.
  void StartTracing(std::uint8_t level = 0, std::uint64_t any = 0, std::uint64_t all = 0) {
    ETWInit();
    EnableTPrint(true);
    m_session = std::make_unique<TraceSession>(ETWProviderId(), level, any, all, m_sink);
  }
  std::vector<std::uint16_t> WrittenIds() const {
    std::vector<std::uint16_t> ids;
    for (const TraceRecord& record : m_sink.Records()) ids.push_back(record.descriptor.Id);
    return ids;
  }

  MemoryTraceSink m_sink;
  std::unique_ptr<TraceSession> m_session;
};

TEST_F(TPrintTest, NothingIsWrittenUntilInitEnableAndASessionAllAgree) {
  EXPECT_FALSE(IsTPrintEnabled());
  EnableTPrint(true);  // no tracing object: no effect
  EXPECT_FALSE(IsTPrintEnabled());
  TraceSession session(ETWProviderId(), 0, 0, 0, m_sink);
  TPrint(1);
  ETWInit();
  TPrint(1);  // TPrint still disabled
  EnableTPrint(true);
  EXPECT_TRUE(IsTPrintEnabled());
  TPrint(3, 7);
  session.Stop();
  TPrint(1);  // no session
  EXPECT_EQ(WrittenIds(), std::vector<std::uint16_t>{3});
  ETWReset();
  EXPECT_FALSE(IsTPrintEnabled());
}

TEST_F(TPrintTest, IdsWithoutAnEventWriteNothing) {
  StartTracing();
  EXPECT_EQ(ETWLogging::TableSize(), 99u);
  for (const short id : {0, 9, 42, 54, 99, 120, -1, -32768}) {
    TPrint(id);
    TPrint(id, 5, "text");
  }
  EXPECT_TRUE(m_sink.Records().empty());
}

TEST_F(TPrintTest, EachKindWritesItsPayloadShape) {
  StartTracing();
  TPrint(1, 99, L"ignored");           // none
  TPrint(8, -3);                       // int
  TPrint(8, L"text only");             // int, value missing: 0
  TPrint(30, 5, L"Cal µ");             // string: the value is ignored
  TPrint(31);                          // string, text missing: empty
  TPrint(32, static_cast<const wchar_t*>(nullptr));
  TPrint(33, "8-bit \xC2\xB5");        // converted from UTF-8
  TPrint(20, 5, static_cast<const wchar_t*>(nullptr));  // int and string
  TPrint(21, 6, static_cast<const char*>(nullptr));
  TPrint(22, 7);
  const std::vector<std::vector<std::vector<std::uint8_t>>> expected = {
      {},
      {Int32Bytes(-3)},
      {Int32Bytes(0)},
      {TextBytes(L"Cal µ")},
      {TextBytes(L"")},
      {TextBytes(L"NULL")},
      {TextBytes(L"8-bit µ")},
      {Int32Bytes(5), TextBytes(L"NULL")},
      {Int32Bytes(6), TextBytes(L"NULL")},
      {Int32Bytes(7), TextBytes(L"")},
  };
  const std::vector<TraceRecord> records = m_sink.Records();
  ASSERT_EQ(records.size(), expected.size());
  for (std::size_t i = 0; i < records.size(); ++i) {
    EXPECT_EQ(records[i].items, expected[i]) << "event " << records[i].descriptor.Id;
  }
  EXPECT_EQ(records[1].descriptor.Keyword, 0x8000000000000001);
}

TEST_F(TPrintTest, SessionLevelAndKeywordsChooseTheEvents) {
  StartTracing(15);  // below the events' level 16
  TPrint(1);
  m_session = std::make_unique<TraceSession>(ETWProviderId(), 16, 0x1, 0, m_sink);
  TPrint(1);   // Measurement and Sweep: has the "any" bit
  TPrint(12);  // Display only
  TPrint(20, 1, L"c");  // Remote only
  m_session = std::make_unique<TraceSession>(ETWProviderId(), 255, 0, 0x8000000000000021, m_sink);
  TPrint(1);
  TPrint(20, 1, L"c");
  TPrint(22, 1, L"q");  // Remote and Measurement: all bits
  EXPECT_EQ(WrittenIds(), (std::vector<std::uint16_t>{1, 22}));
}

TEST_F(TPrintTest, ResetEndsTracingAndALaterInitStartsIt) {
  StartTracing();
  TPrint(1);
  ETWReset();
  TPrint(2);
  ETWInit();  // a new object: TPrint off again; the running session enables it at once
  TPrint(2);
  EnableTPrint(true);
  TPrint(2);
  EXPECT_EQ(ETWLogging::TableSize(), 99u);
  EXPECT_EQ(WrittenIds(), (std::vector<std::uint16_t>{1, 2}));
}

TEST_F(TPrintTest, SessionFileListsTheEventsByName) {
  testutil::TempDir dir;
  ETWInit();
  EnableTPrint(true);
  {
    JsonTraceFileSink file(dir.Path("sweep.json"), &ETWManifest());
    TraceSession session(ETWProviderId(), 0, 0, 0, file);
    TPrint(1);
    TPrint(3, 2);
    TPrint(30, L"factory \"cal\"");
    TPrint(4, 2);
    TPrint(2);
    session.Stop();
    file.Close();
  }
  boost::property_tree::ptree tree;
  boost::property_tree::read_json(dir.NarrowPath("sweep.json"), tree);
  std::vector<std::string> names, events, phases;
  for (const auto& child : tree.get_child("traceEvents")) {
    names.push_back(child.second.get<std::string>("name"));
    events.push_back(child.second.get<std::string>("args.event"));
    phases.push_back(child.second.get<std::string>("ph"));
  }
  EXPECT_EQ(names, (std::vector<std::string>{"Sweep", "ChannelSweep", "CalSetLoad",
                                             "ChannelSweep", "Sweep"}));
  EXPECT_EQ(events, (std::vector<std::string>{"SweepStart", "ChannelSweepStart", "CalSetLoadStart",
                                              "ChannelSweepStop", "SweepStop"}));
  EXPECT_EQ(phases, (std::vector<std::string>{"B", "B", "B", "E", "E"}));
  const auto second = std::next(tree.get_child("traceEvents").begin());
  EXPECT_EQ(second->second.get<int>("args.value"), 2);
  EXPECT_EQ(std::next(second)->second.get<std::string>("args.text"), "factory \"cal\"");
  EXPECT_EQ(tree.get<std::string>("otherData.provider"), "LumenUtility");
}

TEST_F(TPrintTest, ThreadsTraceWhileSessionsAndTheSwitchChange) {
  StartTracing();
  std::atomic<bool> stop{false};
  std::vector<std::thread> tracers;
  for (int t = 0; t < 3; ++t) {
    tracers.emplace_back([t] {
      for (int i = 0; i < 2000; ++i) {
        TPrint(3, i);
        TPrint(30, "cal");
        TPrint(static_cast<short>(20 + t), i, L"command");
      }
    });
  }
  std::thread controller([&] {
    MemoryTraceSink other;
    for (int i = 0; !stop; ++i) {
      TraceSession session(ETWProviderId(), static_cast<std::uint8_t>(i % 20), 0x1, 0, other);
    }
  });
  std::thread switcher([&] {
    for (int i = 0; !stop; ++i) EnableTPrint(i % 4 != 0);
    EnableTPrint(true);
  });
  for (std::thread& tracer : tracers) tracer.join();
  stop = true;
  controller.join();
  switcher.join();
  EXPECT_LE(m_sink.Records().size(), 3u * 3 * 2000);
  EXPECT_GT(m_sink.Records().size(), 0u);
}

}  // namespace
