// MonotonicLocator: FindNearestIndex(stimulus, 0.0, value) in O(log N) for a stimulus that
// ascends or descends (flat runs allowed) and holds only finite values.
//
// The plain search visits every segment, and an arbitrary segment visits every pair of
// neighbours, so resampling a 100001-point arbitrary trace would cost 10^10 steps. Order lets
// the locator bisect instead: over the pieces (segments and the gaps between them, whose
// ranges follow each other) and, inside an arbitrary segment, over its points. The answer is
// computed by the same formulas and picks the same crossing where values repeat, so results
// match the plain search bit for bit. (The two could part only where a quotient
// (value - a) / (b - a) of the plain search rounds across 0 or 1, which needs neighbouring
// stimulus steps more than 2^52 apart in size.)
//
// Each search starts from where the previous one ended, so a sweep of new values in order
// costs about constant time per value (and never more than log N).
// Thread-safety: confine to one thread (searches update the start hint); the stimulus must
// outlive the locator and stay unchanged.
#pragma once

#include <cstddef>
#include <vector>

#include "lumen/stimulus/input_array.h"

namespace LumenUtility {

class MonotonicLocator {
 public:
  // Preconditions: stimulus not empty, Direction over it not SLOPE_MIXED, every value finite.
  explicit MonotonicLocator(const InputArray& stimulus);

  // Fractional index in [0, size - 1]: the value's crossing nearest index 0, or the nearer end
  // index when the stimulus does not reach it (the last on a tie, 0 for NaN).
  double Find(double value);

  // Searches inside arbitrary segments whose bisected pair the plain search would not accept
  // (rounding at extreme step ratios) and that were answered by the plain search instead.
  std::size_t PlainSearchFallbacks() const { return m_fallbacks; }

 private:
  // A segment with points, or the gap from the last point of one such segment to the first of
  // the next. Ranges are in key space (values negated for a descending stimulus), so pieces
  // follow each other in ascending order.
  struct Piece {
    double keyLow;
    double keyHigh;
    unsigned int base;   // overall index of the segment's first point, or of the gap's start
    unsigned int count;  // segment points; 0 marks a gap
    const Segment* segment;
    // Arbitrary segments: index of the last pair of neighbours that differ, -1 when all equal.
    std::ptrdiff_t lastStep;
  };

  double Key(double value) const { return m_descending ? -value : value; }
  // Candidate of one piece, or a negative number when the piece does not reach the value.
  double Offer(const Piece& piece, double value);
  double FindInArbitrary(const Piece& piece, double value);

  const double* m_points;
  unsigned int m_size;
  bool m_descending;
  std::vector<Piece> m_pieces;
  std::size_t m_lastPiece = 0;  // piece that answered the previous search
  std::ptrdiff_t m_hint = 0;    // point (within its segment) found by the previous search
  std::size_t m_fallbacks = 0;
};

}  // namespace LumenUtility
