#include "lumen/platform/trace_session.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <atomic>
#include <cstring>
#include <mutex>
#include <thread>
#include <vector>

#include "lumen/platform/memory_trace_sink.h"

namespace {

using namespace LumenUtility;

// Each test uses its own provider, so registrations of other tests never interfere.
GUID TestProvider(std::uint8_t n) {
  return GUID{0x11111111, 0x2222, 0x3333, {0x44, 0x55, 0x66, 0x77, 0x88, 0x99, 0xAA, n}};
}

struct EnableCall {
  std::uint32_t isEnabled;
  std::uint8_t level;
  std::uint64_t any;
  std::uint64_t all;
};

struct CallbackLog {
  std::mutex mutex;
  std::vector<EnableCall> calls;
};

void RecordEnable(const GUID*, std::uint32_t isEnabled, std::uint8_t level, std::uint64_t any,
                  std::uint64_t all, EVENT_FILTER_DESCRIPTOR* filter, void* context) {
  EXPECT_EQ(filter, nullptr);
  auto* log = static_cast<CallbackLog*>(context);
  const std::lock_guard<std::mutex> lock(log->mutex);
  log->calls.push_back(EnableCall{isEnabled, level, any, all});
}

// A registration that ends with the test.
class Provider {
 public:
  Provider(const GUID& id, CallbackLog* log) {
    EXPECT_EQ(EventRegister(&id, log ? RecordEnable : nullptr, log, &m_handle), ERROR_SUCCESS);
    EXPECT_NE(m_handle, 0u);
  }
  ~Provider() { EventUnregister(m_handle); }
  std::uint32_t Write(std::uint16_t id, std::uint8_t level, std::uint64_t keyword,
                      std::int32_t value) {
    const EVENT_DESCRIPTOR descriptor{id, 1, 16, level, 10, 1, keyword};
    EVENT_DATA_DESCRIPTOR data;
    EventDataDescCreate(&data, &value, sizeof value);
    return EventWrite(m_handle, &descriptor, 1, &data);
  }
  REGHANDLE Handle() const { return m_handle; }

 private:
  REGHANDLE m_handle = 0;
};

std::vector<std::uint16_t> Ids(const MemoryTraceSink& sink) {
  std::vector<std::uint16_t> ids;
  for (const TraceRecord& record : sink.Records()) ids.push_back(record.descriptor.Id);
  return ids;
}

TEST(TraceSession, EnableCallbackFollowsSessionsAndHearsOfThoseStartedBeforeIt) {
  const GUID id = TestProvider(1);
  MemoryTraceSink sink;
  CallbackLog log;
  {
    TraceSession early(id, 5, 0x6, 0x2, sink);
    Provider provider(id, &log);  // registered while a session runs: told at once
    {
      TraceSession second(id, 0, 0x1, 0x3, sink);
      TraceSession otherProvider(TestProvider(99), 9, 0, 0, sink);  // not this provider's
    }
    early.Stop();
    early.Stop();
  }
  ASSERT_EQ(log.calls.size(), 4u);
  const auto expect = [&](std::size_t i, std::uint32_t on, std::uint8_t level, std::uint64_t any,
                          std::uint64_t all) {
    EXPECT_EQ(log.calls[i].isEnabled, on) << i;
    EXPECT_EQ(log.calls[i].level, level) << i;
    EXPECT_EQ(log.calls[i].any, any) << i;
    EXPECT_EQ(log.calls[i].all, all) << i;
  };
  expect(0, EVENT_CONTROL_CODE_ENABLE_PROVIDER, 5, 0x6, 0x2);
  expect(1, EVENT_CONTROL_CODE_ENABLE_PROVIDER, 0, 0x7, 0x2);  // level 0 is the widest wish
  expect(2, EVENT_CONTROL_CODE_ENABLE_PROVIDER, 5, 0x6, 0x2);
  expect(3, EVENT_CONTROL_CODE_DISABLE_PROVIDER, 0, 0, 0);
}

TEST(TraceSession, AnAnyMaskOfZeroTakesEveryKeyword) {
  const GUID id = TestProvider(2);
  CallbackLog log;
  Provider provider(id, &log);
  MemoryTraceSink sink;
  TraceSession session(id, 0, 0, 0, sink);
  ASSERT_EQ(log.calls.size(), 1u);
  EXPECT_EQ(log.calls[0].any, ~std::uint64_t{0});
  provider.Write(1, 16, 0x8000000000000001, 0);
  provider.Write(2, 255, 0x20, 0);
  EXPECT_EQ(Ids(sink), (std::vector<std::uint16_t>{1, 2}));
}

TEST(TraceSession, EachSessionRecordsOnlyTheLevelsAndKeywordsItAskedFor) {
  const GUID id = TestProvider(3);
  Provider provider(id, nullptr);
  MemoryTraceSink verbose, narrow;
  TraceSession verboseSession(id, 16, 0x3, 0, verbose);
  TraceSession narrowSession(id, 4, 0x1, 0x8000000000000000, narrow);
  provider.Write(1, 16, 0x8000000000000001, 0);  // level too high for the narrow session
  provider.Write(2, 4, 0x8000000000000001, 0);
  provider.Write(3, 4, 0x0000000000000001, 0);   // lacks the bit "all" needs
  provider.Write(4, 4, 0x8000000000000004, 0);   // no bit of either "any" mask
  provider.Write(5, 17, 0x1, 0);                 // above every level
  provider.Write(6, 1, 0, 0);                    // no keywords: always matches
  EXPECT_EQ(Ids(verbose), (std::vector<std::uint16_t>{1, 2, 3, 6}));
  EXPECT_EQ(Ids(narrow), (std::vector<std::uint16_t>{2, 6}));
}

TEST(TraceSession, RecordsCopyTheDescriptorPayloadAndWriter) {
  const GUID id = TestProvider(4);
  Provider provider(id, nullptr);
  MemoryTraceSink sink;
  TraceSession session(id, 0, 0, 0, sink);
  const EVENT_DESCRIPTOR descriptor{77, 0, 16, 16, 11, 9, 0x8000000000000021};
  std::int32_t value = -5;
  const char16_t text[] = u"ab";
  EVENT_DATA_DESCRIPTOR data[3];
  EventDataDescCreate(&data[0], &value, 4);
  EventDataDescCreate(&data[1], text, sizeof text);
  EventDataDescCreate(&data[2], nullptr, 0);
  ASSERT_EQ(EventWrite(provider.Handle(), &descriptor, 3, data), ERROR_SUCCESS);
  value = 0;  // the record holds a copy
  const std::vector<TraceRecord> records = sink.Records();
  ASSERT_EQ(records.size(), 1u);
  const TraceRecord& record = records[0];
  EXPECT_TRUE(record.providerId == id);
  EXPECT_EQ(std::memcmp(&record.descriptor, &descriptor, sizeof descriptor), 0);
  EXPECT_GT(record.timestampNs, 0);
  EXPECT_EQ(record.processId, static_cast<std::uint32_t>(getpid()));
  ASSERT_EQ(record.items.size(), 3u);
  EXPECT_EQ(record.items[0], (std::vector<std::uint8_t>{0xFB, 0xFF, 0xFF, 0xFF}));
  EXPECT_EQ(record.items[1], (std::vector<std::uint8_t>{'a', 0, 'b', 0, 0, 0}));
  EXPECT_TRUE(record.items[2].empty());
}

TEST(TraceSession, BadCallsAreRefusedWithTheirErrorAndWriteNothing) {
  const GUID id = TestProvider(5);
  REGHANDLE handle = 0;
  EXPECT_EQ(EventRegister(nullptr, nullptr, nullptr, &handle), ERROR_INVALID_PARAMETER);
  EXPECT_EQ(EventRegister(&id, nullptr, nullptr, nullptr), ERROR_INVALID_PARAMETER);
  Provider provider(id, nullptr);
  MemoryTraceSink sink;
  TraceSession session(id, 0, 0, 0, sink);
  const EVENT_DESCRIPTOR descriptor{1, 1, 16, 16, 10, 1, 0};
  std::vector<std::uint8_t> big(kMaxEventPayloadBytes + 1);
  EVENT_DATA_DESCRIPTOR data[kMaxEventDataDescriptors + 1] = {};
  EXPECT_EQ(EventWrite(provider.Handle(), nullptr, 0, nullptr), ERROR_INVALID_PARAMETER);
  EXPECT_EQ(EventWrite(provider.Handle(), &descriptor, 1, nullptr), ERROR_INVALID_PARAMETER);
  EXPECT_EQ(EventWrite(provider.Handle(), &descriptor, kMaxEventDataDescriptors + 1, data),
            ERROR_INVALID_PARAMETER);
  data[0].Size = 4;  // size without data
  EXPECT_EQ(EventWrite(provider.Handle(), &descriptor, 1, data), ERROR_INVALID_PARAMETER);
  EventDataDescCreate(&data[0], big.data(), static_cast<std::uint32_t>(big.size()));
  EXPECT_EQ(EventWrite(provider.Handle(), &descriptor, 1, data), ERROR_ARITHMETIC_OVERFLOW);
  EXPECT_EQ(EventWrite(provider.Handle() + 1000, &descriptor, 0, nullptr), ERROR_INVALID_HANDLE);
  EXPECT_EQ(EventUnregister(provider.Handle() + 1000), ERROR_INVALID_HANDLE);
  EXPECT_TRUE(sink.Records().empty());
}

TEST(TraceSession, WritersOnManyThreadsMeetSessionsStartingAndStopping) {
  const GUID id = TestProvider(6);
  Provider provider(id, nullptr);
  MemoryTraceSink always, sometimes;
  TraceSession alwaysSession(id, 0, 0, 0, always);
  std::atomic<bool> stop{false};
  std::vector<std::thread> writers;
  for (int t = 0; t < 3; ++t) {
    writers.emplace_back([&, t] {
      for (int i = 0; i < 2000; ++i) provider.Write(static_cast<std::uint16_t>(t), 16, 0x1, i);
    });
  }
  std::thread controller([&] {
    while (!stop) {
      TraceSession session(id, 0, 0, 0, sometimes);
    }
  });
  for (std::thread& writer : writers) writer.join();
  stop = true;
  controller.join();
  EXPECT_EQ(always.Records().size(), 6000u);
  EXPECT_LE(sometimes.Records().size(), 6000u);
}

}  // namespace
