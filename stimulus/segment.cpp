#include "lumen/stimulus/segment.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {
namespace {

using PointVector = std::vector<double>;

boost::shared_ptr<PointVector> MakePoints(const double* p, unsigned int n) {
  return boost::shared_ptr<PointVector>(new PointVector(p, p + n));
}

// Point i of an n-point linear sweep; the ends are exact.
double LinearPoint(double start, double stop, unsigned int n, unsigned int i) {
  if (i == 0) return start;
  if (i == n - 1) return stop;
  return start + i * (stop - start) / (n - 1);
}

}  // namespace

Segment::Segment() : m_start(0), m_stop(0), m_numPoints(0), m_type(Linear), m_offset(0) {}

Segment::Segment(double value, unsigned int n) : Segment() {
  SetSegment(value, n);
}

Segment::Segment(double start, double stop, unsigned int n, SegmentType t) : Segment() {
  SetSegment(start, stop, n, t);
}

Segment::Segment(const std::vector<double>& v) : Segment() {
  SetSegment(v);
}

Segment::Segment(const double* p, unsigned int n) : Segment() {
  m_type = Arbitrary;
  m_numPoints = n;
  m_pCache = MakePoints(p, n);
}

void Segment::SetSegment(double value, unsigned int n) {
  m_start = m_stop = value;
  m_numPoints = n;
  m_type = Fixed;
  ClearCache();
}

void Segment::SetSegment(double start, double stop, unsigned int n, SegmentType t) {
  m_start = start;
  m_stop = stop;
  m_numPoints = n;
  m_type = n <= 1 ? Fixed : (t == Arbitrary ? Linear : t);
  ClearCache();
}

void Segment::SetSegment(const std::vector<double>& v) {
  m_start = m_stop = 0;
  m_numPoints = static_cast<unsigned int>(v.size());
  m_type = Arbitrary;
  m_pCache = MakePoints(v.data(), m_numPoints);
  m_offset = 0;
}

void Segment::clear() {
  *this = Segment();
}

bool Segment::IsFixed() const {
  switch (m_type) {
    case Linear:
    case Log:
      return m_start == m_stop;
    case Fixed:
      return true;
    case Arbitrary: {
      if (m_numPoints <= 1) return true;
      const double* p = CachedPoints();
      return std::all_of(p + 1, p + m_numPoints, [&](double v) { return v == p[0]; });
    }
  }
  throw LumenException(E_FAIL, L"Unhandled case in Segment::IsFixed.");
}

double Segment::at(unsigned int i) const {
  if (m_pCache) return m_pCache->at(std::size_t{m_offset} + i);
  switch (m_type) {
    case Linear:
      if (i >= m_numPoints) throw LumenException(E_FAIL, L"index");
      return LinearPoint(m_start, m_stop, m_numPoints, i);
    case Log:
      if (i >= m_numPoints) throw LumenException(E_FAIL, L"index");
      return ComputeLogPoint(m_start, m_stop, static_cast<int>(m_numPoints), static_cast<int>(i));
    case Fixed:
      return m_start;
    default:
      throw LumenException(LUMEN_E_BOUNDS, L"Segment::at");
  }
}

double Segment::back() const {
  if (m_numPoints == 0) throw LumenException(E_FAIL, L"Segment::back()");
  return at(m_numPoints - 1);
}

double Segment::min_element() const {
  if (m_type != Arbitrary) return m_type == Fixed ? m_start : std::min(m_start, m_stop);
  if (m_numPoints == 0) return std::numeric_limits<double>::quiet_NaN();
  return *std::min_element(CachedPoints(), CachedPoints() + m_numPoints);
}

double Segment::max_element() const {
  if (m_type != Arbitrary) return m_type == Fixed ? m_start : std::max(m_start, m_stop);
  if (m_numPoints == 0) return std::numeric_limits<double>::quiet_NaN();
  return *std::max_element(CachedPoints(), CachedPoints() + m_numPoints);
}

double Segment::Find(double value, bool fromEnd) const {
  if (m_numPoints == 0) return -1.0;
  const double first = front();
  const double last = back();
  if (!((value >= first && value <= last) || (value <= first && value >= last))) return -1.0;
  if (m_numPoints == 1) return 0.0;
  const double lastIndex = m_numPoints - 1;
  switch (m_type) {
    case Linear: {
      const double f = first == last ? (fromEnd ? 1.0 : 0.0) : (value - first) / (last - first);
      const double k = f * lastIndex;
      const double nearest = std::round(k);
      // A value that is exactly a grid point reports the exact index. The quotient can round
      // to one ulp past the last point, which a caller trusting the index would read beyond.
      if (value == m_start + (m_stop - m_start) * nearest / lastIndex) return nearest;
      return std::min(k, lastIndex);
    }
    case Log: {
      if (first == last) return (fromEnd ? 1.0 : 0.0) * lastIndex;
      const double k = lastIndex * (std::log10(value) - std::log10(first)) /
                       (std::log10(last) - std::log10(first));
      return std::clamp(k, 0.0, lastIndex);
    }
    case Fixed:
      if (value == m_start) return fromEnd ? 1.0 : 0.0;
      return -1.0;
    case Arbitrary:
      break;
  }
  // Without fromEnd the highest crossing pair wins, with it the lowest.
  const double* p = CachedPoints();
  double found = 0.0;
  auto share = [value](double a, double b) { return (value - a) / (b - a); };
  if (!fromEnd) {
    for (unsigned int i = 0; i + 1 < m_numPoints; ++i) {
      const double r = share(p[i], p[i + 1]);
      if (r >= 0.0 && r <= 1.0) found = i + r;
    }
  } else {
    for (unsigned int i = m_numPoints - 1; i >= 1; --i) {
      const double r = share(p[i - 1], p[i]);
      if (r >= 0.0 && r <= 1.0) found = (i - 1) + r;
    }
  }
  return found;
}

void Segment::GetArray(std::vector<double>& out) const {
  out.resize(m_numPoints);
  GetArray(out.data(), m_numPoints);
  if (!m_pCache && (m_type == Linear || m_type == Log)) RefreshCache(out);
}

std::vector<double> Segment::GetArray() const {
  std::vector<double> out;
  GetArray(out);
  return out;
}

void Segment::GetArray(double* out, unsigned int capacity) const {
  const unsigned int m = std::min(m_numPoints, capacity);
  if (m_pCache) {
    std::copy(CachedPoints(), CachedPoints() + m, out);
    return;
  }
  switch (m_type) {
    case Linear:
      for (unsigned int i = 0; i < m; ++i) out[i] = LinearPoint(m_start, m_stop, m_numPoints, i);
      return;
    case Log:
      if (m == m_numPoints) {
        ComputeLogPoints(m_start, m_stop, static_cast<int>(m), out);
      } else {
        // A short buffer receives the first points of this segment, not a shorter sweep.
        std::vector<double> all;
        ComputeLogPoints(m_start, m_stop, static_cast<int>(m_numPoints), all);
        std::copy(all.begin(), all.begin() + m, out);
      }
      return;
    case Fixed:
      std::fill(out, out + m, m_start);
      return;
    default:
      throw LumenException(LUMEN_E_BOUNDS, L"Segment::at");
  }
}

bool Segment::operator==(const Segment& other) const {
  if (m_numPoints != other.m_numPoints) return false;
  if (m_type == other.m_type) {
    switch (m_type) {
      case Linear:
      case Log:
        return m_start == other.m_start && m_stop == other.m_stop;
      case Fixed:
        return m_start == other.m_start;
      default:
        break;
    }
  } else if (m_type != Arbitrary && other.m_type != Arbitrary) {
    if (m_type == Fixed || other.m_type == Fixed) {
      const Segment& fixed = m_type == Fixed ? *this : other;
      const Segment& ramp = m_type == Fixed ? other : *this;
      return ramp.m_start == fixed.m_start && ramp.m_stop == fixed.m_start;
    }
    // One Linear, one Log: only two points describe the same sequence.
    return m_numPoints == 2 && m_start == other.m_start && m_stop == other.m_stop;
  }
  for (unsigned int i = 0; i < m_numPoints; ++i) {
    if (at(i) != other.at(i)) return false;
  }
  return true;
}

template <typename Change>
void Segment::ChangeArbitraryPoints(Change change) {
  const bool solePlainOwner =
      m_pCache.use_count() == 1 && m_offset == 0 && m_pCache->size() == m_numPoints;
  if (!solePlainOwner) {
    m_pCache = MakePoints(CachedPoints(), m_numPoints);
    m_offset = 0;
  }
  for (double& v : *m_pCache) v = change(v);
}

Segment& Segment::operator+=(double x) {
  if (m_type == Log && m_numPoints > 2) {
    // Adding a constant destroys logarithmic spacing: keep the points themselves.
    SetSegment(GetArray());
  }
  if (m_type == Arbitrary) {
    ChangeArbitraryPoints([x](double v) { return v + x; });
  } else {
    m_start += x;
    m_stop += x;
    ClearCache();
  }
  return *this;
}

Segment& Segment::operator*=(double x) {
  if (m_type == Arbitrary) {
    ChangeArbitraryPoints([x](double v) { return v * x; });
  } else {
    m_start *= x;
    m_stop *= x;
    ClearCache();
  }
  return *this;
}

Segment Segment::operator+(double x) const {
  return Segment(*this) += x;
}

Segment Segment::operator*(double x) const {
  return Segment(*this) *= x;
}

void Segment::reverse() {
  if (m_numPoints == 0 || m_type == Fixed) return;
  if (m_type == Arbitrary) {
    m_pCache = MakePoints(CachedPoints(), m_numPoints);
    m_offset = 0;
    std::reverse(m_pCache->begin(), m_pCache->end());
    return;
  }
  std::swap(m_start, m_stop);
  ClearCache();
}

void Segment::SetCache(boost::shared_ptr<std::vector<double>> pCache, unsigned int offset) const {
  if (pCache) {
    if (pCache->size() < std::size_t{m_numPoints} + offset) {
      throw LumenException(E_FAIL, L"Invalid pCache set in Segment::SetCache");
    }
    m_pCache = std::move(pCache);
    m_offset = offset;
    return;
  }
  if (m_type != Arbitrary) {
    ClearCache();
    return;
  }
  // Detach from a shared flattened array: keep a private vector of exactly our points.
  const bool ownsExactPoints =
      m_pCache.use_count() == 1 && m_offset == 0 && m_pCache->size() == m_numPoints;
  if (!ownsExactPoints) {
    m_pCache = MakePoints(CachedPoints(), m_numPoints);
    m_offset = 0;
  }
}

void Segment::RefreshCache(const std::vector<double>& values) const {
  RefreshCache(values.data(), static_cast<unsigned int>(values.size()));
}

void Segment::RefreshCache(const double* values, unsigned int n) const {
  if (m_pCache) return;
  m_pCache = MakePoints(values, n);
  m_offset = 0;
}

void Segment::ClearCache() const {
  m_pCache.reset();
  m_offset = 0;
}

}  // namespace LumenUtility
