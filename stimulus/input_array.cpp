#include "lumen/stimulus/input_array.h"

#include <algorithm>
#include <cmath>

#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {
namespace {

unsigned int CheckedCount(int n) {
  if (n < 0) throw LumenException(E_FAIL, L"count");
  return static_cast<unsigned int>(n);
}

const std::vector<Segment>& EmptySegments() {
  static const std::vector<Segment> empty;
  return empty;
}

}  // namespace

InputArray::InputArray() : m_size(0) {}

InputArray::InputArray(const Segment& s) : InputArray() {
  SetArray(s);
}

InputArray::InputArray(double value, int n) : InputArray() {
  SetArray(value, n);
}

InputArray::InputArray(double start, double stop, int n, SegmentType t) : InputArray() {
  SetArray(start, stop, n, t);
}

InputArray::InputArray(const std::vector<double>& v) : InputArray() {
  SetArray(v);
}

InputArray::InputArray(const double* p, unsigned int n) : InputArray() {
  SetArray(p, n);
}

double InputArray::operator[](unsigned int i) const {
  if (i >= m_size || !m_pSegments) throw LumenException(E_FAIL, L"index");
  if (m_pArray) return (*m_pArray)[i];
  for (const Segment& s : *m_pSegments) {
    if (i < s.size()) return s.at(i);
    i -= s.size();
  }
  throw LumenException(E_FAIL, L"InputArray::operator[]");
}

unsigned int InputArray::NumSegments() const {
  return m_pSegments ? static_cast<unsigned int>(m_pSegments->size()) : 0;
}

const std::vector<Segment>& InputArray::GetSegments() const {
  return m_pSegments ? *m_pSegments : EmptySegments();
}

Segment InputArray::GetSegment(unsigned int k) const {
  if (k >= NumSegments()) throw LumenException(E_FAIL, L"segIndex");
  return (*m_pSegments)[k];
}

const Segment& InputArray::GetSegmentFromPtIndex(int i) const {
  if (i >= 0 && static_cast<unsigned int>(i) < m_size) {
    unsigned int local = static_cast<unsigned int>(i);
    for (const Segment& s : GetSegments()) {
      if (local < s.size()) return s;
      local -= s.size();
    }
  }
  throw LumenException(E_FAIL, L"index");
}

void InputArray::GetArray(std::vector<double>& out) const {
  out.resize(m_size);
  unsigned int offset = 0;
  for (const Segment& s : GetSegments()) {
    s.GetArray(out.data() + offset, m_size - offset);
    offset += s.size();
  }
}

std::vector<double> InputArray::GetArray() const {
  std::vector<double> out;
  GetArray(out);
  return out;
}

boost::shared_ptr<const std::vector<double>> InputArray::GetArrayPtr() const {
  RefreshCache();
  return m_pArray;
}

const double* InputArray::GetRawArray() const {
  if (m_size == 0) return nullptr;
  RefreshCache();
  return m_pArray->data();
}

void InputArray::RefreshCache() const {
  if (m_pArray) return;
  auto flattened = boost::shared_ptr<std::vector<double>>(new std::vector<double>(m_size));
  unsigned int offset = 0;
  for (const Segment& s : GetSegments()) {
    for (unsigned int j = 0; j < s.size() && offset + j < m_size; ++j) {
      (*flattened)[offset + j] = s.at(j);
    }
    offset += s.size();
  }
  if (offset != m_size) throw LumenException(E_FAIL, L"InputArray::operator[]");
  offset = 0;
  for (const Segment& s : GetSegments()) {
    s.SetCache(flattened, offset);
    offset += s.size();
  }
  m_pArray = flattened;
}

void InputArray::ClearCache() {
  if (!m_pArray) return;
  m_pArray.reset();
  if (m_pSegments) {
    for (const Segment& s : MutableSegments()) s.SetCache(nullptr, 0);
  }
}

std::vector<Segment>& InputArray::MutableSegments() {
  if (!m_pSegments) {
    m_pSegments.reset(new std::vector<Segment>());
  } else if (m_pSegments.use_count() != 1) {
    m_pSegments.reset(new std::vector<Segment>(*m_pSegments));
  }
  return *m_pSegments;
}

double InputArray::min_element() const {
  if (NumSegments() == 0) throw LumenException(E_FAIL, L"InputArray::min_element: no segments");
  double result = m_pSegments->front().min_element();
  for (const Segment& s : *m_pSegments) result = std::min(result, s.min_element());
  return result;
}

double InputArray::max_element() const {
  if (NumSegments() == 0) throw LumenException(E_FAIL, L"InputArray::max_element: no segments");
  double result = m_pSegments->front().max_element();
  for (const Segment& s : *m_pSegments) result = std::max(result, s.max_element());
  return result;
}

bool InputArray::IsConstant() const {
  if (m_size <= 1 || NumSegments() == 0) return true;
  if (NumSegments() == 1) return m_pSegments->front().IsFixed();
  const double first = (*this)[0];
  return std::all_of(m_pSegments->begin(), m_pSegments->end(), [first](const Segment& s) {
    return s.IsFixed() && (s.empty() || s.front() == first);
  });
}

bool InputArray::IsMonotonic() const {
  if (m_size == 0) return false;
  if (m_size == 1) return true;
  const std::vector<double> points = GetArray();
  const bool falling = points.back() < points.front();
  for (std::size_t i = 1; i < points.size(); ++i) {
    if (points[i] == points[i - 1]) continue;
    if ((points[i] < points[i - 1]) != falling) return false;
  }
  return true;
}

bool InputArray::IsRamp() const {
  return IsConstant() || (NumSegments() == 1 && !m_pSegments->front().IsArbitrary());
}

bool InputArray::IsSubsetOf(const InputArray& other, double tolerance) const {
  return other.min_element() - min_element() <= tolerance &&
         max_element() - other.max_element() <= tolerance;
}

bool InputArray::IsExactSubset(const InputArray& other) const {
  // NaN equals nothing, so it can never be found; leaving it out also keeps the sort sound.
  auto sortedNumbers = [](std::vector<double> v) {
    v.erase(std::remove_if(v.begin(), v.end(), [](double x) { return std::isnan(x); }), v.end());
    std::sort(v.begin(), v.end());
    return v;
  };
  const std::vector<double> mine = sortedNumbers(GetArray());
  if (mine.size() != m_size) return false;
  const std::vector<double> theirs = sortedNumbers(other.GetArray());
  std::vector<double> common;
  std::set_intersection(mine.begin(), mine.end(), theirs.begin(), theirs.end(),
                        std::back_inserter(common));
  return common.size() == m_size;
}

void InputArray::SplitInputArrayAtValue(double low, double high, std::vector<int>& indices) const {
  indices.clear();
  const std::vector<double> points = GetArray();
  for (std::size_t i = 0; i < points.size(); ++i) {
    if (low <= points[i] && points[i] <= high) indices.push_back(static_cast<int>(i));
  }
}

bool InputArray::operator==(const InputArray& other) const {
  if (m_pSegments == other.m_pSegments) return true;
  if (m_size != other.m_size) return false;
  const std::vector<Segment>& mine = GetSegments();
  const std::vector<Segment>& theirs = other.GetSegments();
  if (mine.size() == theirs.size() && std::equal(mine.begin(), mine.end(), theirs.begin())) {
    return true;
  }
  for (unsigned int i = 0; i < m_size; ++i) {
    if ((*this)[i] != other[i]) return false;
  }
  return true;
}

void InputArray::SetArray(const Segment& s) {
  m_pArray.reset();
  m_pSegments.reset(new std::vector<Segment>(1, s));
  m_size = s.size();
  m_pSegments->front().SetCache(nullptr, 0);
}

void InputArray::SetArray(double value, int n) {
  SetArray(Segment(value, CheckedCount(n)));
}

void InputArray::SetArray(double start, double stop, int n, SegmentType t) {
  SetArray(Segment(start, stop, CheckedCount(n), t));
}

void InputArray::SetArray(const std::vector<double>& v) {
  SetArray(Segment(v));
}

void InputArray::SetArray(const double* p, unsigned int n) {
  SetArray(Segment(p, n));
}

void InputArray::push_back(const Segment& s) {
  MutableSegments().push_back(s);
  m_size += s.size();
  ClearCache();
}

void InputArray::pop_back() {
  if (NumSegments() == 0) return;
  std::vector<Segment>& segments = MutableSegments();
  m_size -= segments.back().size();
  segments.pop_back();
  ClearCache();
}

void InputArray::insert(const Segment& s, unsigned int k) {
  if (k > NumSegments()) throw LumenException(E_FAIL, L"segIndex");
  std::vector<Segment>& segments = MutableSegments();
  segments.insert(segments.begin() + k, s);
  m_size += s.size();
  ClearCache();
}

void InputArray::erase(unsigned int k) {
  if (k >= NumSegments()) return;
  std::vector<Segment>& segments = MutableSegments();
  m_size -= segments[k].size();
  segments.erase(segments.begin() + k);
  ClearCache();
}

void InputArray::ReplaceSegment(const Segment& s, unsigned int k) {
  if (k >= NumSegments()) throw LumenException(E_FAIL, L"segIndex");
  std::vector<Segment>& segments = MutableSegments();
  m_size = m_size - segments[k].size() + s.size();
  segments[k] = s;
  ClearCache();
}

void InputArray::reverse() {
  if (NumSegments() == 0) return;
  std::vector<Segment>& segments = MutableSegments();
  std::reverse(segments.begin(), segments.end());
  for (Segment& s : segments) s.reverse();
  ClearCache();
}

void InputArray::clear() {
  m_pSegments.reset();
  m_pArray.reset();
  m_size = 0;
}

InputArray& InputArray::operator+=(double x) {
  if (NumSegments() == 0) return *this;
  ClearCache();
  for (Segment& s : MutableSegments()) s += x;
  return *this;
}

InputArray& InputArray::operator*=(double x) {
  if (NumSegments() == 0) return *this;
  ClearCache();
  for (Segment& s : MutableSegments()) s *= x;
  return *this;
}

InputArray InputArray::operator+(double x) const {
  return InputArray(*this) += x;
}

InputArray InputArray::operator*(double x) const {
  return InputArray(*this) *= x;
}

void InputArray::operator+=(const InputArray& other) {
  const std::vector<Segment> appended = other.GetSegments();  // `other` may be *this
  std::vector<Segment>& segments = MutableSegments();
  segments.insert(segments.end(), appended.begin(), appended.end());
  m_size += other.m_size;
  ClearCache();
}

}  // namespace LumenUtility
