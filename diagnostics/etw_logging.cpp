#include "diagnostics/etw_logging.h"

#include <boost/make_shared.hpp>

#include "diagnostics/etw_catalogue.h"
#include "diagnostics/etw_provider.h"
#include "lumen/diagnostics/event_tracing.h"

namespace LumenUtility {
namespace {

// Indexed by event id; empty entries for ids without an event.
std::vector<boost::shared_ptr<ETWLogging::Logger>> sm_loggers;

boost::shared_ptr<ETWLogging> s_pETWLogging;

boost::shared_ptr<ETWLogging::Logger> MakeLogger(const ETWEventDefinition& event) {
  const EVENT_DESCRIPTOR* descriptor = &event.descriptor;
  switch (event.kind) {
    case ETWLoggerKind::None: return boost::make_shared<ETWLogging::Logger_NONE>(descriptor);
    case ETWLoggerKind::Int: return boost::make_shared<ETWLogging::Logger_INT>(descriptor);
    case ETWLoggerKind::String: return boost::make_shared<ETWLogging::Logger_STRING>(descriptor);
    case ETWLoggerKind::IntString:
      return boost::make_shared<ETWLogging::Logger_INT_STRING>(descriptor);
  }
  return {};
}

}  // namespace

ETWLogging::ETWLogging() {
  if (sm_loggers.empty()) FillTable();
  m_registered = ETWProvider::Register();
}

ETWLogging::~ETWLogging() {
  if (m_registered) ETWProvider::Unregister();
}

void ETWLogging::FillTable() {
  for (const ETWEventDefinition& event : ETWCatalogue()) {
    const std::uint16_t id = event.descriptor.Id;
    if (id >= sm_loggers.size()) sm_loggers.resize(id + 1u);
    sm_loggers[id] = MakeLogger(event);
  }
}

boost::shared_ptr<ETWLogging::Logger> ETWLogging::FindLogger(short id) {
  const auto index = static_cast<std::uint16_t>(id);
  if (index >= sm_loggers.size()) return {};
  return sm_loggers[index];
}

std::size_t ETWLogging::TableSize() {
  return sm_loggers.size();
}

ETWLogging* ETWLogging::Current() {
  return s_pETWLogging.get();
}

void ETWInit() {
  if (!s_pETWLogging) s_pETWLogging = boost::make_shared<ETWLogging>();
}

void ETWReset() {
  s_pETWLogging.reset();
}

void EnableTPrint(bool enabled) {
  if (ETWLogging* const logging = ETWLogging::Current()) logging->EnableTPrint(enabled);
}

bool IsTPrintEnabled() {
  const ETWLogging* const logging = ETWLogging::Current();
  return logging != nullptr && logging->IsTPrintEnabled();
}

}  // namespace LumenUtility
