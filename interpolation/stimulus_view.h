// Ascending read access to a stimulus list that may be stored in descending order.
#pragma once

namespace LumenUtility {

// Presents count stimulus values (float or double) in ascending order: a list whose last
// value lies below its first is read from its far end. Index i of the view is element
// Physical(i) of the list. Holds a pointer to the caller's list; count must be >= 1.
template <typename T>
class StimulusView {
 public:
  StimulusView(const T* x, int count) : m_x(x), m_count(count), m_mirrored(x[count - 1] < x[0]) {}

  int Physical(int i) const { return m_mirrored ? m_count - 1 - i : i; }
  double operator[](int i) const { return m_x[Physical(i)]; }

  // Last index whose value is <= v (-1 when none). A binary search over the ascending order;
  // it ends after log2(count) steps whatever the values (NaN, unordered) are.
  int LastAtOrBelow(double v) const {
    int lo = 0, hi = m_count;
    while (lo < hi) {
      const int mid = lo + (hi - lo) / 2;
      if ((*this)[mid] <= v) {
        lo = mid + 1;
      } else {
        hi = mid;
      }
    }
    return lo - 1;
  }

  // First index whose value is >= v (count when none), searched the same way.
  int FirstAtOrAbove(double v) const {
    int lo = 0, hi = m_count;
    while (lo < hi) {
      const int mid = lo + (hi - lo) / 2;
      if ((*this)[mid] < v) {
        lo = mid + 1;
      } else {
        hi = mid;
      }
    }
    return lo;
  }

 private:
  const T* m_x;
  int m_count;
  bool m_mirrored;
};

}  // namespace LumenUtility
