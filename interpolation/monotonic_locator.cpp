#include "interpolation/monotonic_locator.h"

#include <algorithm>
#include <cmath>

#include "interpolation/gallop_search.h"

namespace LumenUtility {

MonotonicLocator::MonotonicLocator(const InputArray& stimulus)
    : m_points(stimulus.GetRawArray()),
      m_size(stimulus.size()),
      m_descending(stimulus.size() > 1 && m_points[m_size - 1] < m_points[0]) {
  const std::vector<Segment>& segments = stimulus.GetSegments();
  m_pieces.reserve(2 * segments.size());
  unsigned int base = 0;
  for (const Segment& segment : segments) {
    const unsigned int n = segment.size();
    if (n == 0) continue;
    const double first = m_points[base];
    const double last = m_points[base + n - 1];
    if (!m_pieces.empty()) {
      // The gap from the previous segment's last point to this segment's first one.
      const double previous = m_points[base - 1];
      m_pieces.push_back({std::min(Key(previous), Key(first)), std::max(Key(previous), Key(first)),
                          base - 1, 0, nullptr, -1});
    }
    std::ptrdiff_t lastStep = -1;
    if (segment.IsArbitrary()) {
      for (std::ptrdiff_t i = static_cast<std::ptrdiff_t>(n) - 2; i >= 0; --i) {
        if (m_points[base + i] != m_points[base + i + 1]) {
          lastStep = i;
          break;
        }
      }
    }
    m_pieces.push_back({std::min(Key(first), Key(last)), std::max(Key(first), Key(last)), base, n,
                        &segment, lastStep});
    base += n;
  }
}

double MonotonicLocator::Find(double value) {
  const double key = Key(value);
  // The first piece that can reach the value; pieces before it end below it. Several pieces
  // reach a value that ends one and starts the next, and the earliest accepting one wins.
  auto it = m_pieces.begin() + m_lastPiece;
  const bool hintHolds = it->keyHigh >= key && (m_lastPiece == 0 || it[-1].keyHigh < key);
  if (!hintHolds) {
    it = std::partition_point(m_pieces.begin(), m_pieces.end(),
                              [key](const Piece& p) { return p.keyHigh < key; });
  }
  for (; it != m_pieces.end() && it->keyLow <= key; ++it) {
    const double candidate = Offer(*it, value);
    if (candidate >= 0.0) {
      m_lastPiece = static_cast<std::size_t>(it - m_pieces.begin());
      return std::min(candidate, m_size - 1.0);
    }
  }
  const double toFirst = std::fabs(value - m_points[0]);
  const double toLast = std::fabs(value - m_points[m_size - 1]);
  return toLast <= toFirst ? m_size - 1.0 : 0.0;
}

double MonotonicLocator::Offer(const Piece& piece, double value) {
  if (piece.count == 0) {
    const double low = m_points[piece.base];
    const double t = (value - low) / (m_points[piece.base + 1] - low);
    return t >= 0.0 && t <= 1.0 ? piece.base + t : -1.0;
  }
  if (piece.count > 1 && piece.segment->IsArbitrary()) return FindInArbitrary(piece, value);
  // Linear, log and fixed segments answer from their description in constant time.
  const double r = piece.segment->Find(value, false);
  return r >= 0.0 ? piece.base + r : -1.0;
}

// The plain search of an arbitrary segment keeps the last pair of neighbours (a, b) with
// 0 <= (value - a) / (b - a) <= 1. In an ordered segment that is the pair starting at the last
// point not beyond the value, or, when the value equals the segment's end, the last pair that
// differs (pairs of equal points never accept).
double MonotonicLocator::FindInArbitrary(const Piece& piece, double value) {
  const double* p = m_points + piece.base;
  const double key = Key(value);
  const auto count = static_cast<std::ptrdiff_t>(piece.count);
  if (!(key >= Key(p[0]) && key <= Key(p[count - 1]))) return -1.0;
  std::ptrdiff_t i =
      GallopBoundary(count, m_hint, [&](std::ptrdiff_t k) { return Key(p[k]) > key; }) - 1;
  m_hint = i;
  if (i == count - 1) {
    i = piece.lastStep;
    if (i < 0) return piece.base;  // all points equal: no pair accepts, the segment answers 0
  }
  const double r = (value - p[i]) / (p[i + 1] - p[i]);
  if (r >= 0.0 && r <= 1.0) return piece.base + (static_cast<double>(i) + r);
  ++m_fallbacks;
  return piece.base + piece.segment->Find(value, false);
}

}  // namespace LumenUtility
