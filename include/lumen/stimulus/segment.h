/** @file */
/// @class LumenUtility::Segment
/// Segment: one run of stimulus points (frequencies in Hz, powers in dBm, times in s).
///
/// A segment describes its points compactly when it can: Linear and Log by their two end
/// values and point count, Fixed by its one value and count, and only Arbitrary by an explicit
/// point list. Points of any type may be materialised into a shared, lazily built cache
/// (a vector of doubles viewed from an offset) that an InputArray hands to all its segments.
/// Copies share the cache; no operation writes into a vector another owner can see.
/// Thread-safety: confine to one thread; const reads may fill the (mutable) cache. Copies that
/// share a cache may live on different threads (the reference count is atomic).
#pragma once

#include <boost/shared_ptr.hpp>

#include <iosfwd>
#include <vector>

#include "lumen/export.h"

namespace LumenUtility {

/// How a segment's points are spaced: Linear and Log between two end values (Log
/// geometrically, so both ends > 0), Fixed at one value, Arbitrary as an explicit list.
enum SegmentType : int { Linear = 0, Log = 1, Fixed = 2, Arbitrary = 3 };

class Archive;
class InputArray;

class LUMEN_API Segment {
 public:
  Segment();                              ///< Linear, 0 points
  Segment(double value, unsigned int n);  ///< Fixed
  /// As SetSegment with the same arguments.
  Segment(double start, double stop, unsigned int n, SegmentType t);
  explicit Segment(const std::vector<double>& v);  ///< Arbitrary, private copy
  Segment(const double* p, unsigned int n);        ///< Arbitrary, private copy

  /// Fixed at `value`; cache dropped.
  void SetSegment(double value, unsigned int n);
  /// n of 0 or 1 gives Fixed; t = Arbitrary gives Linear; cache dropped.
  void SetSegment(double start, double stop, unsigned int n, SegmentType t);
  void SetSegment(const std::vector<double>& v);  ///< Arbitrary, private copy
  void clear();                                   ///< the default segment

  /// How the points are spaced.
  SegmentType GetType() const { return m_type; }
  /// Number of points.
  unsigned int size() const { return m_numPoints; }
  /// True when the segment has no points.
  bool empty() const { return m_numPoints == 0; }
  ///@{
  /// True when the segment is of that type.
  bool IsLinear() const { return m_type == Linear; }
  bool IsLog() const { return m_type == Log; }
  bool IsArbitrary() const { return m_type == Arbitrary; }
  ///@}
  /// All points equal. Throws LumenException E_FAIL for an unknown type.
  bool IsFixed() const;

  /// Point i. Through the cache when there is one (std::out_of_range past the cache vector);
  /// an uncached Linear or Log segment throws LumenException(E_FAIL, "index") for i >= size;
  /// Fixed returns its value for any i. Constant time, no allocation.
  double at(unsigned int i) const;
  /// Point i, as at().
  double operator[](unsigned int i) const { return at(i); }
  /// First point, as at(0).
  double front() const { return at(0); }
  /// Throws LumenException(E_FAIL, "Segment::back()") when empty.
  double back() const;
  ///@{
  /// Smallest / largest point; constant time except for Arbitrary. An empty Arbitrary segment
  /// gives NaN.
  double min_element() const;
  double max_element() const;
  ///@}

  /// Fractional point index (integer part: point; fraction: share of the way to the next)
  /// at which the segment reaches `value`, or -1.0 when it lies outside [front, back].
  /// Never past size() - 1. `fromEnd` picks the last crossing instead of the first where the
  /// segment is flat or non-monotonic.
  double Find(double value, bool fromEnd) const;

  /// `out` becomes the points; an uncached Linear or Log segment keeps them as its cache.
  void GetArray(std::vector<double>& out) const;
  /// The points as a new vector; an uncached Linear or Log segment keeps them as its cache.
  std::vector<double> GetArray() const;
  /// Writes min(size(), capacity) points; never creates a cache.
  void GetArray(double* out, unsigned int capacity) const;

  ///@{
  /// Equality of the point sequences, exact.
  bool operator==(const Segment& other) const;
  bool operator!=(const Segment& other) const { return !(*this == other); }
  ///@}

  /// Persisted forms. Every recall checks the record against the bytes there are before it
  /// trusts a count, and leaves the segment as it was when it throws.
  ///
  /// Storing: writes the archive-form record (version 1, start, stop, count, type, and for
  /// Arbitrary the byte count and the points). Loading: reads one; throws LumenException
  /// 0xE8080882 "InputArray::Segment serialization failed." for a version other than 1, and
  /// with code 0xE8080882 for a type outside 0 to 3, a byte count other than 8 x the point
  /// count, or too few bytes (the archive's message, then one naming this record).
  void Serialize(Archive& ar);
  /// The packed record: 32 bytes, plus 8 per point for Arbitrary. A null `buffer` returns the
  /// record size; a `bufferSize` (bytes) below it returns 0 and writes nothing; else writes
  /// the record and returns its size. Throws LumenException 0xE8080882 for a record larger
  /// than 2^31 - 1 bytes.
  int SaveData(unsigned char* buffer, int bufferSize) const;
  /// Reads the packed record at `buffer` (`bufferSize` bytes readable) and returns its record
  /// size. Versions above 1 are read as 1. Throws LumenException 0xE8080882 "Unhandled recall
  /// version in InputArray Segment" for version 0 or below, and with the same code and a
  /// message naming the record when the buffer is shorter than the record or its header, the
  /// record size does not fit the points, or the type is outside 0 to 3.
  int RecallData(const unsigned char* buffer, int bufferSize);

  ///@{
  /// Adds `x` to, or multiplies by `x`, every point; Log of more than 2 points shifted by `x`
  /// becomes Arbitrary.
  Segment& operator+=(double x);  ///< Log of more than 2 points becomes Arbitrary
  Segment& operator*=(double x);
  Segment operator+(double x) const;
  Segment operator*(double x) const;
  ///@}
  /// Reverses the order of the points (start and stop swap).
  void reverse();

 private:
  friend class InputArray;
  friend std::wostream& operator<<(std::wostream& os, const Segment& s);

  /// View `pCache` from `offset`; a null pointer detaches (see the cache rules in the .cpp).
  /// Throws LumenException(E_FAIL, "Invalid pCache set in Segment::SetCache") when the vector
  /// holds fewer than offset + size() values.
  void SetCache(boost::shared_ptr<std::vector<double>> pCache, unsigned int offset) const;
  /// Creates a private cache holding `values` when there is none.
  void RefreshCache(const std::vector<double>& values) const;
  void RefreshCache(const double* values, unsigned int n) const;
  void ClearCache() const;
  /// Changes an Arbitrary segment's points through `change`, writing into a private vector.
  template <typename Change>
  void ChangeArbitraryPoints(Change change);
  const double* CachedPoints() const { return m_pCache->data() + m_offset; }

  double m_start;
  double m_stop;
  unsigned int m_numPoints;
  SegmentType m_type;
  mutable boost::shared_ptr<std::vector<double>> m_pCache;
  mutable unsigned int m_offset;
};

/// One logarithmically spaced point of a numPts-point sweep from start to stop (> 0).
/// Throws std::invalid_argument("numPts") for numPts < 1 and ("index") for index >= numPts.
LUMEN_API double ComputeLogPoint(double start, double stop, int numPts, int index);
///@{
/// numPts points into out[0 .. numPts-1]; first and last exactly start and stop. Throws
/// std::invalid_argument without writing for numPts < 0 or start, stop <= 0.
LUMEN_API void ComputeLogPoints(double start, double stop, int numPts, double* out);
LUMEN_API void ComputeLogPoints(double start, double stop, int numPts, std::vector<double>& out);
///@}

/// Text form: "LIN,n,start,stop", "LOG,n,start,stop", "FIX,n,value" or "ARB,n,p0,...".
LUMEN_API std::wostream& operator<<(std::wostream& os, const Segment& s);
/// Reads the text form; an unknown type token or a short read sets failbit and leaves `s`
/// unchanged.
LUMEN_API std::wistream& operator>>(std::wistream& is, Segment& s);

}  // namespace LumenUtility
