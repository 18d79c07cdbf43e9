/** @file */
/// @class LumenUtility::InputArray
/// InputArray: the stimulus array, an ordered list of Segments read as one array of doubles.
///
/// A cheap copy-on-write value: copies share the segment list and the flattened point cache
/// until one of them changes. A 20001-point linear sweep is one segment until a caller asks
/// for raw points; then one flattened vector serves the array and all its segments.
/// Thread-safety: confine each object to one thread (const reads may build the cache and
/// repoint the shared segments); copies may live on different threads.
#pragma once

#include <boost/shared_ptr.hpp>

#include <cstddef>
#include <iosfwd>
#include <iterator>
#include <vector>

#include "lumen/export.h"
#include "lumen/stimulus/segment.h"

class CArchive;

namespace LumenUtility {

class Archive;

class LUMEN_API InputArray {
 public:
  /// Random-access iterator over the points, yielding each by value; valid while the array
  /// it was taken from lives and keeps its size.
  class const_iterator {
   public:
    ///@{
    /// The usual random-access iterator types and operators; comparing iterators of
    /// different arrays is meaningless, and dereferencing past the end throws as operator[].
    using iterator_category = std::random_access_iterator_tag;
    using value_type = double;
    using difference_type = std::ptrdiff_t;
    using pointer = void;
    using reference = double;

    const_iterator() = default;
    const_iterator(unsigned int index, const InputArray* array) : m_index(index), m_array(array) {}
    double operator*() const { return (*m_array)[m_index]; }
    double operator[](difference_type n) const { return (*m_array)[m_index + n]; }
    const_iterator& operator++() {
      ++m_index;
      return *this;
    }
    const_iterator operator++(int) {
      const_iterator old = *this;
      ++m_index;
      return old;
    }
    const_iterator& operator--() {
      --m_index;
      return *this;
    }
    const_iterator operator--(int) {
      const_iterator old = *this;
      --m_index;
      return old;
    }
    const_iterator& operator+=(difference_type n) {
      m_index += n;
      return *this;
    }
    const_iterator& operator-=(difference_type n) {
      m_index -= n;
      return *this;
    }
    friend const_iterator operator+(const_iterator it, difference_type n) { return it += n; }
    friend const_iterator operator+(difference_type n, const_iterator it) { return it += n; }
    friend const_iterator operator-(const_iterator it, difference_type n) { return it -= n; }
    friend difference_type operator-(const const_iterator& a, const const_iterator& b) {
      return static_cast<difference_type>(a.m_index) - static_cast<difference_type>(b.m_index);
    }
    friend bool operator==(const const_iterator& a, const const_iterator& b) {
      return a.m_index == b.m_index && a.m_array == b.m_array;
    }
    friend auto operator<=>(const const_iterator& a, const const_iterator& b) {
      return a.m_index <=> b.m_index;
    }
    ///@}

   private:
    unsigned int m_index = 0;
    const InputArray* m_array = nullptr;
  };

  /// An empty array without segments.
  InputArray();
  ///@{
  /// The array of one segment, as SetArray with the same arguments; a negative count `n`
  /// throws LumenException(E_FAIL, "count").
  explicit InputArray(const Segment& s);
  InputArray(double value, int n);
  InputArray(double start, double stop, int n, SegmentType t);
  explicit InputArray(const std::vector<double>& v);
  InputArray(const double* p, unsigned int n);
  ///@}

  /// Number of points, over all segments.
  unsigned int size() const { return m_size; }
  /// True when the array has no points.
  bool empty() const { return m_size == 0; }
  /// Point i; LumenException(E_FAIL, "index") for i >= size().
  double operator[](unsigned int i) const;
  /// Point i, as operator[].
  double at(unsigned int i) const { return (*this)[i]; }
  /// First point; throws LumenException(E_FAIL, "index") when empty.
  double front() const { return (*this)[0]; }
  /// Last point; throws LumenException(E_FAIL, "index") when empty.
  double back() const { return (*this)[m_size - 1]; }
  /// Iterator at the first point.
  const_iterator begin() const { return const_iterator(0, this); }
  /// Iterator past the last point.
  const_iterator end() const { return const_iterator(m_size, this); }

  /// Number of segments (0 for a default-constructed array).
  unsigned int NumSegments() const;
  /// The segments in order; an empty list when there are none.
  const std::vector<Segment>& GetSegments() const;
  /// Throws LumenException(E_FAIL, "segIndex") for k >= NumSegments().
  Segment GetSegment(unsigned int k) const;
  /// Throws LumenException(E_FAIL, "index") past the end.
  const Segment& GetSegmentFromPtIndex(int i) const;

  ///@{
  /// Every point in order, as one vector of size() values.
  void GetArray(std::vector<double>& out) const;
  std::vector<double> GetArray() const;
  ///@}
  /// The flattened points, shared; built on first use.
  boost::shared_ptr<const std::vector<double>> GetArrayPtr() const;
  /// Null when empty, else the first flattened point.
  const double* GetRawArray() const;

  ///@{
  /// Smallest / largest point. Throws LumenException(E_FAIL) for an array without segments.
  double min_element() const;
  double max_element() const;
  ///@}
  /// True when every point has the same value (also for 0 or 1 points).
  bool IsConstant() const;
  /// True when the points never turn back (equal neighbours allowed); false when empty.
  bool IsMonotonic() const;
  /// True when the array is constant or one Linear, Log or Fixed segment.
  bool IsRamp() const;
  /// Range test: min(other) - min(this) <= tolerance and max(this) - max(other) <= tolerance.
  bool IsSubsetOf(const InputArray& other, double tolerance) const;
  /// Every point of this array, counted with repeats, occurs exactly in `other`.
  bool IsExactSubset(const InputArray& other) const;
  /// `indices` becomes, in rising order, every i with low <= point i <= high.
  void SplitInputArrayAtValue(double low, double high, std::vector<int>& indices) const;

  ///@{
  /// Equality of the point sequences, exact, whatever the segment boundaries.
  bool operator==(const InputArray& other) const;
  bool operator!=(const InputArray& other) const { return !(*this == other); }
  ///@}

  ///@{
  /// The array becomes one segment, built as the Segment constructors with the same
  /// arguments (`value` and `n`: Fixed; `start`, `stop`, `n`, `t`: Linear or Log; a vector or
  /// `n` doubles at `p`: Arbitrary, copied). A negative `n` throws
  /// LumenException(E_FAIL, "count") and leaves the array as it was.
  void SetArray(const Segment& s);
  void SetArray(double value, int n);
  void SetArray(double start, double stop, int n, SegmentType t);
  void SetArray(const std::vector<double>& v);
  void SetArray(const double* p, unsigned int n);
  ///@}
  /// Appends segment `s`.
  void push_back(const Segment& s);
  /// Removes the last segment; nothing happens without segments.
  void pop_back();
  /// Inserts before segment k; LumenException(E_FAIL) for k > NumSegments().
  void insert(const Segment& s, unsigned int k);
  /// Removes segment k; nothing happens for k >= NumSegments().
  void erase(unsigned int k);
  /// Throws LumenException(E_FAIL, "segIndex") for k >= NumSegments().
  void ReplaceSegment(const Segment& s, unsigned int k);
  /// Segment k becomes two of m and count - m points. Throws the HRESULT E_INVALIDARG for
  /// m < 1 and LumenException(E_FAIL) for m >= count or k >= NumSegments().
  void SplitSegment(unsigned int k, unsigned int m);
  /// Only for exactly one segment: sets its count to n; false when there is not exactly one
  /// segment or the count already is n. Throws LumenException(E_FAIL) for an Arbitrary
  /// segment asked to grow past its stored points.
  bool Resize(int n);
  /// Reverses the order of the points (and of the segments).
  void reverse();
  /// Removes every segment.
  void clear();
  ///@{
  /// Adds `x` to, or multiplies by `x`, every point (a Log segment of more than two points
  /// shifted by `x` becomes Arbitrary).
  InputArray& operator+=(double x);
  InputArray& operator*=(double x);
  InputArray operator+(double x) const;
  InputArray operator*(double x) const;
  ///@}
  /// Concatenation.
  void operator+=(const InputArray& other);
  /// Replaces arbitrary runs by Linear segments (steps within 0.01 stimulus units).
  void OptimizeRepresentation();
  /// Replaces runs of exactly equal points by Fixed segments.
  void OptimizeRepresentationOnlyFixed();
  /// The points at `indices`, in that order, with runs recombined as OptimizeRepresentation
  /// does. Throws LumenException(E_FAIL, "index") for a negative or out-of-range index.
  InputArray ExtractInputArray(const std::vector<int>& indices) const;

  /// Persisted forms. Every recall checks the record against the bytes there are, rejects
  /// counts the bytes cannot hold before allocating, requires the total point count to be the
  /// sum of the segments' counts, and leaves the array as it was when it throws. Errors are
  /// LumenException 0xE8080882 naming the record unless said otherwise.
  ///
  /// Archive form. Storing: version 1, the segment count, each segment's record. Loading:
  /// throws "InputArray version not recognized" for a version other than 1, and the errors of
  /// Segment::Serialize.
  void Serialize(Archive& ar);
  /// The packed record: 20 bytes plus each segment's packed record. Null `buffer` returns the
  /// record size; a `bufferSize` (bytes) below it returns 0 and writes nothing; else writes
  /// the record and returns its size.
  int SaveData(unsigned char* buffer, int bufferSize) const;
  /// Reads the packed record at `buffer` (`bufferSize` bytes readable) and returns its record
  /// size. A version below 1 changes nothing; a total point count of 0 leaves no segments.
  /// Throws for a buffer shorter than the header or the record, a segment byte count or
  /// segment count the record cannot hold, and the errors of Segment::RecallData.
  int RecallData(const unsigned char* buffer, int bufferSize);
  /// MFC form, written or read by ar.IsStoring(). Loading throws LumenException 0xE8080867
  /// (no message) for an array or segment version above 1; the CArchiveException of a short
  /// archive passes through.
  void Serialize(CArchive& ar);

 private:
  std::vector<Segment>& MutableSegments();
  /// Replaces the array by its runs (linear or constant) when that takes fewer segments or
  /// the array is one arbitrary segment.
  void AdoptRunsIfSimpler(bool linearRuns);
  void RefreshCache() const;
  void ClearCache();
  /// Takes `segments` (holding `total` points together) as the new, unflattened list.
  void AdoptSegments(std::vector<Segment>&& segments, unsigned int total);

  unsigned int m_size;
  boost::shared_ptr<std::vector<Segment>> m_pSegments;
  mutable boost::shared_ptr<std::vector<double>> m_pArray;
};

/// Gives every array the same segment boundaries. Throws LumenException(E_FAIL) when the
/// arrays do not all hold the same number of points.
LUMEN_API void ConformSegments(std::vector<InputArray>& arrays);

///@{
/// Both call a.Serialize(ar): the archive's own mode decides the direction.
LUMEN_API void operator<<(CArchive& ar, InputArray& a);
LUMEN_API void operator>>(CArchive& ar, InputArray& a);
///@}

/// Text form: "(" segments separated by line feeds ")", 15 significant digits.
LUMEN_API std::wostream& operator<<(std::wostream& os, const InputArray& a);
/// Fail state and target unchanged unless the input is a complete "(...)" form.
LUMEN_API std::wistream& operator>>(std::wistream& is, InputArray& a);

}  // namespace LumenUtility
