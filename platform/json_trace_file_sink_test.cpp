#include "lumen/platform/json_trace_file_sink.h"

#include <gtest/gtest.h>

#include <boost/property_tree/json_parser.hpp>
#include <boost/property_tree/ptree.hpp>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

#include "lumen/platform/text_conversion.h"
#include "platform/temp_dir.h"
#include "platform/trace_test_bytes.h"

namespace {

using namespace LumenUtility;
using LumenUtility::testutil::Int32Bytes;
using LumenUtility::testutil::TextBytes;
using boost::property_tree::ptree;
using LumenUtility::testutil::TempDir;

const GUID kProvider = {0x532E117B, 0xE9BD, 0x4FE9, {0xB3, 0xBA, 0xB0, 0x09, 0x37, 0x5F, 0x88, 0x9B}};

TraceManifest TestManifest() {
  return TraceManifest(
      "TestProvider", kProvider,
      {{1, "SweepStart", "Sweep", TracePhase::Begin, {}},
       {2, "SweepStop", "Sweep", TracePhase::End, {{"value", TraceFieldType::Int32}}},
       {3, "Note", "Notes", TracePhase::Instant,
        {{"value", TraceFieldType::Int32}, {"text", TraceFieldType::Utf16String}}}},
      {{0x1, "Measurement"}, {0x4, "Sweep"}});
}

TraceRecord Record(std::uint16_t id, std::uint64_t keyword,
                   std::vector<std::vector<std::uint8_t>> items, std::int64_t ns = 1234567) {
  return TraceRecord{kProvider, EVENT_DESCRIPTOR{id, 1, 16, 16, 10, 1, keyword}, ns, 10, 20,
                     std::move(items)};
}

ptree ReadJson(const std::string& path) {
  ptree tree;
  boost::property_tree::read_json(path, tree);
  return tree;
}

std::vector<ptree> Events(const ptree& tree) {
  std::vector<ptree> events;
  for (const auto& child : tree.get_child("traceEvents")) events.push_back(child.second);
  return events;
}

TEST(JsonTraceFileSink, FileListsEventsByNameWithTheirPayloadAndPhase) {
  TempDir dir;
  const TraceManifest manifest = TestManifest();
  {
    JsonTraceFileSink sink(dir.Path("trace.json"), &manifest);
    sink.Consume(Record(1, 0x8000000000000005, {}));
    sink.Consume(Record(3, 0x8000000000000001,
                        {Int32Bytes(-42), TextBytes(L"say \"hi\"\\\n\tµ€")}, 1000));
    sink.Consume(Record(2, 0, {Int32Bytes(7)}));
    sink.Consume(Record(9, 0x2, {{0x0A, 0xFF}}));           // not in the manifest
    sink.Consume(Record(3, 0x1, {Int32Bytes(1), {0x41}}));  // a text item without its end
  }
  const ptree tree = ReadJson(dir.NarrowPath("trace.json"));
  EXPECT_EQ(tree.get<std::string>("otherData.provider"), "TestProvider");
  EXPECT_EQ(tree.get<std::string>("otherData.providerId"),
            "{532E117B-E9BD-4FE9-B3BA-B009375F889B}");
  const std::vector<ptree> events = Events(tree);
  ASSERT_EQ(events.size(), 5u);
  EXPECT_EQ(events[0].get<std::string>("name"), "Sweep");
  EXPECT_EQ(events[0].get<std::string>("ph"), "B");
  EXPECT_EQ(events[0].get<std::string>("cat"), "Measurement,Sweep");
  EXPECT_EQ(events[0].get<std::string>("ts"), "1234.567");
  EXPECT_EQ(events[0].get<int>("pid"), 10);
  EXPECT_EQ(events[0].get<int>("tid"), 20);
  EXPECT_EQ(events[0].get<std::string>("args.event"), "SweepStart");
  EXPECT_EQ(events[1].get<std::string>("name"), "Note");
  EXPECT_EQ(events[1].get<std::string>("ph"), "i");
  EXPECT_EQ(events[1].get<std::string>("ts"), "1.000");
  EXPECT_EQ(events[1].get<int>("args.value"), -42);
  EXPECT_EQ(Utf8ToWide(events[1].get<std::string>("args.text")), L"say \"hi\"\\\n\tµ€");
  EXPECT_EQ(events[2].get<std::string>("ph"), "E");
  EXPECT_EQ(events[2].get<std::string>("cat"), "TestProvider");  // no named keyword
  EXPECT_EQ(events[2].get<int>("args.value"), 7);
  EXPECT_EQ(events[3].get<std::string>("name"), "event 9");
  EXPECT_EQ(events[3].get<std::string>("args.data0"), "0aff");
  EXPECT_EQ(events[4].get<std::string>("args.data1"), "41");
}

TEST(JsonTraceFileSink, FileAppearsOnlyWhenComplete) {
  TempDir dir;
  const std::string path = dir.NarrowPath("trace.json");
  JsonTraceFileSink sink(dir.Path("trace.json"), nullptr);
  sink.Consume(Record(1, 0, {}));
  EXPECT_FALSE(std::filesystem::exists(path));
  EXPECT_TRUE(std::filesystem::exists(path + ".part"));
  sink.Close();
  sink.Consume(Record(2, 0, {}));  // after Close: dropped
  sink.Close();
  EXPECT_FALSE(std::filesystem::exists(path + ".part"));
  const std::vector<ptree> events = Events(ReadJson(path));
  ASSERT_EQ(events.size(), 1u);
  EXPECT_EQ(events[0].get<std::string>("name"), "event 1");
  EXPECT_EQ(events[0].get<std::string>("cat"), "{532E117B-E9BD-4FE9-B3BA-B009375F889B}");
}

TEST(JsonTraceFileSink, FailuresAreReportedAndLeaveNoFile) {
  TempDir dir;
  try {
    JsonTraceFileSink sink(dir.Path("missing/trace.json"), nullptr);
    FAIL() << "opened a file in a missing directory";
  } catch (const CFileException& error) {
    EXPECT_EQ(error.m_cause, CFileException::fileNotFound);
  }
  // The target name is taken by a directory: the rename fails at Close.
  std::filesystem::create_directories(dir.NarrowPath("trace.json/inside"));
  JsonTraceFileSink sink(dir.Path("trace.json"), nullptr);
  sink.Consume(Record(1, 0, {}));
  EXPECT_THROW(sink.Close(), CFileException);
  EXPECT_FALSE(std::filesystem::exists(dir.NarrowPath("trace.json.part")));
  EXPECT_TRUE(std::filesystem::is_directory(dir.NarrowPath("trace.json/inside")));
}

}  // namespace
