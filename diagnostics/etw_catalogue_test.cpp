#include "diagnostics/etw_catalogue.h"

#include <gtest/gtest.h>

#include <map>
#include <set>
#include <vector>

#include "lumen/diagnostics/event_tracing.h"

namespace {

using namespace LumenUtility;

// The published catalogue: event ids by payload kind, ranges inclusive.
std::map<std::uint16_t, ETWLoggerKind> PublishedKinds() {
  std::map<std::uint16_t, ETWLoggerKind> kinds;
  const auto add = [&](ETWLoggerKind kind, std::vector<std::pair<int, int>> ranges) {
    for (const auto& [first, last] : ranges) {
      for (int id = first; id <= last; ++id) kinds[static_cast<std::uint16_t>(id)] = kind;
    }
  };
  add(ETWLoggerKind::None, {{1, 2}, {7, 7}, {12, 13}, {24, 25}, {65, 86}, {89, 92}});
  add(ETWLoggerKind::Int, {{3, 6}, {8, 8}, {10, 11}, {14, 19}, {26, 29}, {34, 37}, {40, 41},
                           {43, 47}, {49, 53}, {61, 62}, {87, 88}, {93, 98}});
  add(ETWLoggerKind::String, {{30, 33}, {38, 39}, {48, 48}, {55, 60}, {63, 64}});
  add(ETWLoggerKind::IntString, {{20, 23}});
  return kinds;
}

TEST(ETWCatalogue, HoldsThe95PublishedEventsWithTheirPayloadKinds) {
  const std::map<std::uint16_t, ETWLoggerKind> published = PublishedKinds();
  ASSERT_EQ(published.size(), 95u);
  std::map<std::uint16_t, ETWLoggerKind> catalogue;
  for (const ETWEventDefinition& event : ETWCatalogue()) {
    EXPECT_TRUE(catalogue.emplace(event.descriptor.Id, event.kind).second) << event.descriptor.Id;
  }
  EXPECT_EQ(catalogue, published);
}

TEST(ETWCatalogue, DescriptorsKeepTheProviderRules) {
  const std::set<std::uint64_t> groups = {0, 0x1, 0x2, 0x4, 0x5, 0x8, 0x10, 0x20, 0x21};
  std::map<std::uint16_t, std::vector<const ETWEventDefinition*>> byTask;
  std::set<std::string> names;
  for (const ETWEventDefinition& event : ETWCatalogue()) {
    const EVENT_DESCRIPTOR& d = event.descriptor;
    EXPECT_EQ(d.Channel, 16) << d.Id;
    EXPECT_EQ(d.Level, 16) << d.Id;
    EXPECT_EQ(d.Keyword & 0x8000000000000000, 0x8000000000000000) << d.Id;
    EXPECT_EQ(groups.count(d.Keyword & ~0x8000000000000000), 1u) << d.Id;
    EXPECT_LE(d.Version, 1) << d.Id;
    EXPECT_TRUE(names.insert(event.name).second) << event.name;
    byTask[d.Task].push_back(&event);
  }
  // A task is a start and stop pair of one keyword, or a single informational event.
  for (const auto& [task, events] : byTask) {
    if (events.size() == 1) {
      EXPECT_EQ(events[0]->descriptor.Opcode, kETWOpcodeInfo) << task;
      continue;
    }
    ASSERT_EQ(events.size(), 2u) << task;
    EXPECT_EQ(events[0]->descriptor.Opcode, kETWOpcodeStart) << task;
    EXPECT_EQ(events[1]->descriptor.Opcode, kETWOpcodeStop) << task;
    EXPECT_EQ(events[0]->descriptor.Keyword, events[1]->descriptor.Keyword) << task;
  }
  const auto find = [](std::uint16_t id) {
    for (const ETWEventDefinition& event : ETWCatalogue()) {
      if (event.descriptor.Id == id) return event.descriptor;
    }
    return EVENT_DESCRIPTOR{};
  };
  const EVENT_DESCRIPTOR first = find(1), second = find(2);
  EXPECT_EQ(first.Version, 1);
  EXPECT_EQ(first.Opcode, 10);
  EXPECT_EQ(first.Task, 1);
  EXPECT_EQ(first.Keyword, 0x8000000000000005);
  EXPECT_EQ(second.Opcode, 11);
  EXPECT_EQ(second.Task, first.Task);
  EXPECT_EQ(find(8).Keyword, 0x8000000000000001);
}

TEST(ETWManifest, NamesEveryEventAndItsPayloadFields) {
  const TraceManifest& manifest = ETWManifest();
  EXPECT_TRUE(manifest.ProviderId() == ETWProviderId());
  EXPECT_EQ(GuidToString(ETWProviderId()), "{532E117B-E9BD-4FE9-B3BA-B009375F889B}");
  for (const ETWEventDefinition& event : ETWCatalogue()) {
    const TraceEventInfo* info = manifest.Find(event.descriptor.Id);
    ASSERT_NE(info, nullptr) << event.descriptor.Id;
    EXPECT_EQ(info->name, event.name);
    const std::size_t fields = event.kind == ETWLoggerKind::None        ? 0
                               : event.kind == ETWLoggerKind::IntString ? 2
                                                                        : 1;
    EXPECT_EQ(info->fields.size(), fields) << event.name;
  }
  EXPECT_EQ(manifest.Find(9), nullptr);
  EXPECT_EQ(manifest.Find(99), nullptr);
  EXPECT_EQ(manifest.Find(1)->name, "SweepStart");
  EXPECT_EQ(manifest.KeywordNames(0x8000000000000021), "Measurement,Remote");
}

}  // namespace
