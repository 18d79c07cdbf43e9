// The MFC form of an InputArray, read and written through a CArchive.
#include <algorithm>
#include <climits>
#include <cstdint>
#include <string>

#include "lumen/platform/archive.h"
#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/input_array.h"
#include "stimulus/record_checks.h"

namespace LumenUtility {
namespace {

constexpr const wchar_t* kMfcRecord = L"InputArray MFC record";
// Points are read in pieces of this many, so a length the archive cannot back fails at its
// end instead of sizing a vector first.
constexpr std::size_t kPointsPerPiece = 8192;

std::int32_t ReadInt(CArchive& ar) {
  std::int32_t value;
  ar >> value;
  return value;
}

void CheckVersion(CArchive& ar) {
  if (ReadInt(ar) > 1) throw LumenException(LUMEN_E_UNKNOWN_VERSION);
}

std::vector<double> ReadPoints(CArchive& ar, std::size_t count) {
  std::vector<double> points;
  while (points.size() < count) {
    const std::size_t at = points.size();
    const std::size_t piece = std::min(count - at, kPointsPerPiece);
    points.resize(at + piece);
    const auto bytes = static_cast<unsigned>(piece * sizeof(double));
    if (ar.Read(points.data() + at, bytes) != bytes) {
      throw CArchiveException(CArchiveException::endOfFile,
                              ar.GetFile() ? ar.GetFile()->GetFilePath().c_str() : nullptr);
    }
  }
  return points;
}

}  // namespace

void InputArray::Serialize(CArchive& ar) {
  if (ar.IsStoring()) {
    ar << std::int32_t{1} << static_cast<std::int32_t>(m_size);
    if (m_size == 0) return;
    ar << static_cast<std::int32_t>(NumSegments());
    for (const Segment& s : GetSegments()) {
      ar << std::int32_t{1} << s.m_start << s.m_stop << static_cast<std::int32_t>(s.m_numPoints)
         << static_cast<std::int32_t>(s.m_type);
      if (s.m_type != Arbitrary) continue;
      // The whole vector the segment views, which may be the array's flattened points.
      const std::vector<double>& points = *s.m_pCache;
      if (points.size() > INT_MAX / sizeof(double))
        packed::Reject(kMfcRecord, L"point vector too long for a 32-bit length");
      ar << static_cast<std::int32_t>(points.size());
      ar.Write(points.data(), static_cast<unsigned>(points.size() * sizeof(double)));
      ar << static_cast<std::int32_t>(s.m_offset);
    }
    return;
  }
  CheckVersion(ar);
  const auto total = static_cast<std::uint32_t>(ReadInt(ar));
  if (total == 0) {
    clear();
    return;
  }
  const std::int32_t count = ReadInt(ar);
  if (count < 0) packed::Reject(kMfcRecord, L"segment count " + std::to_wstring(count));
  std::vector<Segment> segments;
  for (std::int32_t k = 0; k < count; ++k) {
    CheckVersion(ar);
    Segment s;
    ar >> s.m_start >> s.m_stop;
    s.m_numPoints = static_cast<std::uint32_t>(ReadInt(ar));
    const std::int32_t type = ReadInt(ar);
    if (type < 0 || type > packed::kMaxSegmentType)
      packed::Reject(kMfcRecord, L"segment type " + std::to_wstring(type) + L" is not 0 to 3");
    s.m_type = static_cast<SegmentType>(type);
    if (s.m_type == Arbitrary) {
      const std::int32_t length = ReadInt(ar);
      if (length < 0) packed::Reject(kMfcRecord, L"point vector length " + std::to_wstring(length));
      auto points = boost::shared_ptr<std::vector<double>>(
          new std::vector<double>(ReadPoints(ar, static_cast<std::size_t>(length))));
      const std::int32_t offset = ReadInt(ar);
      if (offset < 0 || std::uint64_t(offset) + s.m_numPoints > std::uint64_t(length)) {
        packed::Reject(kMfcRecord, L"offset " + std::to_wstring(offset) + L" and " +
                                       std::to_wstring(s.m_numPoints) + L" points pass the " +
                                       std::to_wstring(length) + L" stored");
      }
      s.m_pCache = points;
      s.m_offset = static_cast<unsigned int>(offset);
    }
    segments.push_back(s);
  }
  packed::CheckTotalPoints(kMfcRecord, total, segments);
  AdoptSegments(std::move(segments), total);
}

void operator<<(CArchive& ar, InputArray& a) {
  a.Serialize(ar);
}

void operator>>(CArchive& ar, InputArray& a) {
  a.Serialize(ar);
}

}  // namespace LumenUtility
