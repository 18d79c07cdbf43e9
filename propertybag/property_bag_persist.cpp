// The saved forms of a property bag: the archive form (count, then key and payload per item)
// and the legacy flat block of zero-terminated keys with length-prefixed payloads.
#include <bit>
#include <cstdint>
#include <cstring>
#include <utility>
#include <vector>

#include "lumen/platform/archive.h"
#include "lumen/platform/text_conversion.h"
#include "lumen/propertybag/property_bag.h"

static_assert(std::endian::native == std::endian::little,
              "legacy record lengths are little-endian; a big-endian host needs byte swapping");

namespace LumenUtility {

namespace {

// Keys whose items write nothing: an archive names them without a payload.
bool IsKeyWithoutPayload(const std::wstring& key) {
  return key == L"UnguidedIsolationORRIN" || key == L"OrrinUserCharacterizerPropBagItem";
}

// The legacy record's length field: 32 bits, little-endian, right after the key's zero byte.
constexpr std::size_t kLengthBytes = 4;

}  // namespace

void PropertyBag::SaveContext(CArchive& ar) {
  // The entries are taken first, so the count written stays true even if an item's Serialize
  // changes the bag.
  std::vector<std::pair<std::wstring, boost::shared_ptr<PropertyBagItem>>> entries;
  entries.reserve(m_items.size());
  for (const auto& [key, item] : m_items) {
    entries.emplace_back(Utf8ToWide(key), item);
    // Bytes that are not UTF-8 would come back as U+FFFD, a key the bag does not hold, and
    // make the whole archive unreadable: refuse before anything is written.
    if (WideToUtf8(entries.back().first) != key) {
      throw CArchiveException(CArchiveException::genericException);
    }
  }
  ar << static_cast<std::uint32_t>(entries.size());
  for (const auto& [key, item] : entries) {
    ar << key;
    item->Serialize(ar);
  }
}

void PropertyBag::RecallContext(CArchive& ar) {
  std::int32_t count = 0;
  ar >> count;
  for (std::int32_t i = 0; i < count; ++i) {
    std::wstring name;
    ar >> name;
    if (IsKeyWithoutPayload(name)) continue;
    const auto entry = m_items.find(WideToUtf8(name));
    if (entry == m_items.end()) throw CArchiveException(CArchiveException::badIndex);
    const boost::shared_ptr<PropertyBagItem> item = entry->second;
    item->Serialize(ar);
  }
}

void PropertyBag::LegacyRecallContext(const unsigned char* data, int size) {
  if (!data || size < 1) return;
  const std::size_t end = static_cast<std::size_t>(size);
  std::size_t offset = 0;
  while (offset < end) {
    const void* zero = std::memchr(data + offset, 0, end - offset);
    if (!zero) return;
    const std::size_t keyEnd = static_cast<const unsigned char*>(zero) - data;
    const std::string key(reinterpret_cast<const char*>(data + offset), keyEnd - offset);
    offset = keyEnd + 1;
    if (end - offset < kLengthBytes) return;
    std::uint32_t length;
    std::memcpy(&length, data + offset, kLengthBytes);
    offset += kLengthBytes;
    if (length > end - offset) return;
    const auto entry = m_items.find(key);
    if (entry != m_items.end()) {
      const boost::shared_ptr<PropertyBagItem> item = entry->second;
      item->LegacyRecall(data + offset, static_cast<int>(length));
    }
    offset += length;
  }
}

}  // namespace LumenUtility
