#include "lumen/platform/json_trace_file_sink.h"

#include <cerrno>
#include <cstdio>
#include <cstring>

#include "lumen/platform/text_conversion.h"

namespace LumenUtility {
namespace {

// Appends `utf8` as a JSON string literal.
void AppendJsonString(std::string& out, std::string_view utf8) {
  static const char kHex[] = "0123456789abcdef";
  out += '"';
  for (const char c : utf8) {
    const auto byte = static_cast<unsigned char>(c);
    if (c == '"' || c == '\\') {
      out += '\\';
      out += c;
    } else if (byte < 0x20) {
      out += "\\u00";
      out += kHex[byte >> 4];
      out += kHex[byte & 0xF];
    } else {
      out += c;
    }
  }
  out += '"';
}

std::string HexBytes(const std::vector<std::uint8_t>& bytes) {
  static const char kHex[] = "0123456789abcdef";
  std::string text;
  for (const std::uint8_t b : bytes) {
    text += kHex[b >> 4];
    text += kHex[b & 0xF];
  }
  return text;
}

// Nanoseconds as microseconds with three decimals, without a locale's decimal comma.
std::string Microseconds(std::int64_t ns) {
  char text[32];
  const bool negative = ns < 0;
  const std::uint64_t magnitude = negative ? 0 - static_cast<std::uint64_t>(ns)
                                           : static_cast<std::uint64_t>(ns);
  std::snprintf(text, sizeof text, "%s%llu.%03llu", negative ? "-" : "",
                static_cast<unsigned long long>(magnitude / 1000),
                static_cast<unsigned long long>(magnitude % 1000));
  return text;
}

bool FitsField(const std::vector<std::uint8_t>& item, TraceFieldType type) {
  if (type == TraceFieldType::Int32) return item.size() == 4;
  return item.size() >= 2 && item.size() % 2 == 0 && item[item.size() - 1] == 0 &&
         item[item.size() - 2] == 0;
}

// The payload as JSON members: named when the manifest's fields fit the items, else in hex.
void AppendPayload(std::string& out, const TraceRecord& record, const TraceEventInfo* info) {
  const auto& items = record.items;
  bool named = info != nullptr && info->fields.size() == items.size();
  for (std::size_t i = 0; named && i < items.size(); ++i) {
    named = FitsField(items[i], info->fields[i].type);
  }
  for (std::size_t i = 0; i < items.size(); ++i) {
    out += ',';
    if (!named) {
      AppendJsonString(out, "data" + std::to_string(i));
      out += ':';
      AppendJsonString(out, HexBytes(items[i]));
      continue;
    }
    AppendJsonString(out, info->fields[i].name);
    out += ':';
    if (info->fields[i].type == TraceFieldType::Int32) {
      std::int32_t value;
      std::memcpy(&value, items[i].data(), 4);
      out += std::to_string(value);
    } else {
      AppendJsonString(out, WideToUtf8(Utf16LeBytesToWide(items[i].data(), items[i].size() - 2)));
    }
  }
}

}  // namespace

JsonTraceFileSink::JsonTraceFileSink(const std::wstring& path, const TraceManifest* manifest)
    : m_path(path), m_partPath(path + L".part"), m_pManifest(manifest) {
  CFileException error;
  if (!m_file.Open(m_partPath.c_str(), CFile::modeCreate | CFile::modeWrite, &error)) {
    throw error;
  }
  std::string head = "{\"displayTimeUnit\":\"ms\",\"otherData\":{";
  if (manifest != nullptr) {
    head += "\"provider\":";
    AppendJsonString(head, manifest->ProviderName());
    head += ",\"providerId\":";
    AppendJsonString(head, GuidToString(manifest->ProviderId()));
  }
  head += "},\"traceEvents\":[\n";
  WriteText(head);
}

JsonTraceFileSink::~JsonTraceFileSink() {
  try {
    Close();
  } catch (const CFileException&) {
    // Close removed the incomplete file; a destructor has no one to tell.
  }
}

void JsonTraceFileSink::WriteText(const std::string& text) {
  if (m_error) return;
  try {
    m_file.Write(text.data(), static_cast<unsigned>(text.size()));
  } catch (const CFileException& error) {
    m_error = error;
  }
}

void JsonTraceFileSink::Consume(const TraceRecord& record) {
  std::string line = EventJson(record);
  const std::lock_guard<std::mutex> lock(m_mutex);
  if (m_closed) return;
  if (!m_first) line.insert(0, ",\n");
  m_first = false;
  WriteText(line);
}

std::string JsonTraceFileSink::EventJson(const TraceRecord& record) const {
  const std::uint16_t id = record.descriptor.Id;
  const TraceEventInfo* info = nullptr;
  if (m_pManifest != nullptr && record.providerId == m_pManifest->ProviderId()) {
    info = m_pManifest->Find(id);
  }
  const TracePhase phase = info != nullptr ? info->phase : TracePhase::Instant;
  std::string category = m_pManifest != nullptr && info != nullptr
                             ? m_pManifest->KeywordNames(record.descriptor.Keyword)
                             : std::string();
  if (category.empty()) {
    category = info != nullptr ? m_pManifest->ProviderName() : GuidToString(record.providerId);
  }

  std::string json = "{\"name\":";
  if (info == nullptr) {
    AppendJsonString(json, "event " + std::to_string(id));
  } else {
    AppendJsonString(json, phase == TracePhase::Instant ? info->name : info->task);
  }
  json += ",\"cat\":";
  AppendJsonString(json, category);
  json += phase == TracePhase::Begin ? ",\"ph\":\"B\"" : phase == TracePhase::End ? ",\"ph\":\"E\""
                                                                                   : ",\"ph\":\"i\",\"s\":\"t\"";
  json += ",\"ts\":" + Microseconds(record.timestampNs);
  json += ",\"pid\":" + std::to_string(record.processId);
  json += ",\"tid\":" + std::to_string(record.threadId);
  json += ",\"args\":{\"event\":";
  AppendJsonString(json, info != nullptr ? info->name : "event " + std::to_string(id));
  json += ",\"id\":" + std::to_string(id);
  json += ",\"opcode\":" + std::to_string(record.descriptor.Opcode);
  json += ",\"task\":" + std::to_string(record.descriptor.Task);
  AppendPayload(json, record, info);
  json += "}}";
  return json;
}

void JsonTraceFileSink::Close() {
  const std::lock_guard<std::mutex> lock(m_mutex);
  if (m_closed) return;
  m_closed = true;
  WriteText("\n]}\n");
  if (!m_error) {
    try {
      m_file.Close();
    } catch (const CFileException& error) {
      m_error = error;
    }
  }
  const std::string partPath = WideToUtf8(m_partPath);
  if (!m_error && std::rename(partPath.c_str(), WideToUtf8(m_path).c_str()) != 0) {
    m_error = CFileException(CFileException::OsErrorToException(errno), errno, m_path.c_str());
  }
  if (m_error) {
    m_file.Abort();
    std::remove(partPath.c_str());
    throw *m_error;
  }
}

}  // namespace LumenUtility
