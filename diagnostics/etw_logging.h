// ETWLogging: the process-wide tracing object behind ETWInit and TPrint, and the loggers that
// write each event with the payload of its kind.
//
// The event table maps an event id to the logger of its kind, made once for the catalogue's
// descriptors and never changed after; it is shared by every tracing object.
// Thread-safety: loggers and IsTPrintEnabled may be used from any thread. A tracing object is
// created and released by ETWInit and ETWReset only. Ownership: loggers are shared through
// boost::shared_ptr; a TPrint call holds its logger for the duration of the call.
#pragma once

#include <atomic>
#include <cstdint>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "lumen/platform/event_trace.h"

namespace LumenUtility {

class ETWLogging {
 public:
  // Writes one event of a fixed descriptor.
  class Logger {
   public:
    explicit Logger(const EVENT_DESCRIPTOR* descriptor) : m_pDescriptor(descriptor) {}
    virtual ~Logger() = default;
    // Writes the event with the arguments its kind carries, when a session enabled it.
    virtual void WriteEvent(std::int32_t value, const wchar_t* text) = 0;
    // Whether WriteEvent would write now.
    bool IsEnabled() const;
    const EVENT_DESCRIPTOR& Descriptor() const { return *m_pDescriptor; }

   protected:
    const EVENT_DESCRIPTOR* m_pDescriptor;
  };
  // No payload.
  class Logger_NONE : public Logger {
   public:
    using Logger::Logger;
    void WriteEvent(std::int32_t value, const wchar_t* text) override;
  };
  // The value, 4 bytes.
  class Logger_INT : public Logger {
   public:
    using Logger::Logger;
    void WriteEvent(std::int32_t value, const wchar_t* text) override;
  };
  // The text as UTF-16 with its terminating zero; null is written as "NULL".
  class Logger_STRING : public Logger {
   public:
    using Logger::Logger;
    void WriteEvent(std::int32_t value, const wchar_t* text) override;
  };
  // The value, then the text as Logger_STRING writes it.
  class Logger_INT_STRING : public Logger {
   public:
    using Logger::Logger;
    void WriteEvent(std::int32_t value, const wchar_t* text) override;
  };

  // TPrint disabled; fills the event table if it is empty; registers the provider.
  ETWLogging();
  ETWLogging(const ETWLogging&) = delete;
  ETWLogging& operator=(const ETWLogging&) = delete;
  // Unregisters the provider when this object registered it.
  ~ETWLogging();

  bool IsRegistered() const { return m_registered; }
  bool IsTPrintEnabled() const { return m_tprintEnabled.load(std::memory_order_acquire); }
  void EnableTPrint(bool enabled) { m_tprintEnabled.store(enabled, std::memory_order_release); }

  // The logger of event `id` (taken as unsigned), or null when the event has none.
  static boost::shared_ptr<Logger> FindLogger(short id);
  // The number of entries of the event table: 99 once filled (ids 0 to 98), 0 before.
  static std::size_t TableSize();

  // The tracing object, or null outside ETWInit .. ETWReset.
  static ETWLogging* Current();

 private:
  static void FillTable();

  bool m_registered = false;
  std::atomic<bool> m_tprintEnabled{false};
};

}  // namespace LumenUtility
