// Operations that change the segment structure of stimulus arrays: splitting, resizing,
// compacting arbitrary points into ramps, and aligning the boundaries of several arrays.
#include <algorithm>
#include <cmath>

#include "lumen/platform/lumen_exception.h"
#include "lumen/stimulus/input_array.h"

namespace LumenUtility {
namespace {

// Steps within this many stimulus units of the run's first step continue a linear run.
constexpr double kLinearStepTolerance = 0.01;

// Scans `p` into runs and returns them as segments: linear runs of nearly equal steps, or
// runs of exactly equal values.
InputArray BuildCandidate(const std::vector<double>& p, bool linearRuns) {
  InputArray candidate;
  const std::size_t n = p.size();
  std::size_t s = 0;
  while (s < n) {
    std::size_t e = s;
    if (linearRuns) {
      if (s + 1 < n) {
        const double step = p[s + 1] - p[s];
        e = s + 1;
        while (e + 1 < n && std::abs((p[e + 1] - p[e]) - step) < kLinearStepTolerance) ++e;
      }
      candidate.push_back(Segment(p[s], p[e], static_cast<unsigned int>(e - s + 1), Linear));
    } else {
      while (e + 1 < n && p[e + 1] == p[s]) ++e;
      candidate.push_back(Segment(p[s], static_cast<unsigned int>(e - s + 1)));
    }
    s = e + 1;
  }
  return candidate;
}

}  // namespace

void InputArray::SplitSegment(unsigned int k, unsigned int m) {
  if (m < 1) throw static_cast<HRESULT>(E_INVALIDARG);
  if (k >= NumSegments()) throw LumenException(E_FAIL, L"segIndex");
  const Segment original = (*m_pSegments)[k];
  const unsigned int n = original.size();
  if (m >= n) throw LumenException(E_FAIL, L"SplitSegment: split point is not inside the segment");
  Segment first;
  Segment second;
  if (original.IsArbitrary()) {
    const std::vector<double> points = original.GetArray();
    first = Segment(points.data(), m);
    second = Segment(points.data() + m, n - m);
  } else {
    // Each part keeps the type, so a logarithmic part keeps the same point ratio.
    first.SetSegment(original.at(0), original.at(m - 1), m, original.GetType());
    second.SetSegment(original.at(m), original.back(), n - m, original.GetType());
  }
  std::vector<Segment>& segments = MutableSegments();
  segments[k] = first;
  segments.insert(segments.begin() + k + 1, second);
  ClearCache();
}

bool InputArray::Resize(int n) {
  if (NumSegments() != 1) return false;
  if (n < 0) throw LumenException(E_FAIL, L"Resize: negative count");
  const Segment& current = m_pSegments->front();
  const unsigned int count = static_cast<unsigned int>(n);
  if (current.size() == count) return false;
  Segment resized = current;
  if (resized.IsArbitrary()) {
    if (count > current.size()) {
      throw LumenException(E_FAIL, L"Resize: an arbitrary segment cannot grow past its points");
    }
    const std::vector<double> points = current.GetArray();
    resized = Segment(points.data(), count);
  } else {
    resized.m_numPoints = count;
    resized.ClearCache();
  }
  MutableSegments().front() = resized;
  m_size = count;
  ClearCache();
  return true;
}

void InputArray::OptimizeRepresentation() {
  AdoptRunsIfSimpler(true);
}

void InputArray::OptimizeRepresentationOnlyFixed() {
  AdoptRunsIfSimpler(false);
}

void InputArray::AdoptRunsIfSimpler(bool linearRuns) {
  if (m_size == 0) return;
  if (m_size == 1 && NumSegments() == 1 && !m_pSegments->front().IsArbitrary()) {
    SetArray((*this)[0], 1);
    return;
  }
  InputArray candidate = BuildCandidate(GetArray(), linearRuns);
  const bool singleArbitrary = NumSegments() == 1 && m_pSegments->front().IsArbitrary();
  if (candidate.NumSegments() < NumSegments() || singleArbitrary) *this = candidate;
}

InputArray InputArray::ExtractInputArray(const std::vector<int>& indices) const {
  std::vector<double> points;
  points.reserve(indices.size());
  for (int i : indices) {
    if (i < 0) throw LumenException(E_FAIL, L"index");
    points.push_back((*this)[static_cast<unsigned int>(i)]);
  }
  InputArray extracted(points);
  extracted.OptimizeRepresentation();
  return extracted;
}

void ConformSegments(std::vector<InputArray>& arrays) {
  if (arrays.empty()) return;
  const unsigned int size = arrays.front().size();
  for (const InputArray& a : arrays) {
    if (a.size() != size) {
      throw LumenException(E_FAIL, L"ConformSegments: the arrays hold different numbers of points");
    }
  }
  auto anyHas = [&](auto predicate) {
    return std::any_of(arrays.begin(), arrays.end(), [&](const InputArray& a) {
      return std::any_of(a.GetSegments().begin(), a.GetSegments().end(), predicate);
    });
  };
  const bool anyArbitrary = anyHas([](const Segment& s) { return s.IsArbitrary(); });
  const bool anyLog = anyHas([](const Segment& s) { return s.IsLog(); });
  const bool allSingleLog = std::all_of(arrays.begin(), arrays.end(), [](const InputArray& a) {
    return a.NumSegments() == 1 && a.GetSegments().front().IsLog();
  });
  if (anyArbitrary || (anyLog && !allSingleLog)) {
    for (InputArray& a : arrays) a.SetArray(a.GetArray());
    return;
  }
  // Empty segments hold no boundary worth aligning and would make a zero-point split.
  for (InputArray& a : arrays) {
    for (unsigned int k = a.NumSegments(); k-- > 0;) {
      if (a.GetSegments()[k].empty()) a.erase(k);
    }
  }
  for (unsigned int k = 0; k < arrays.front().NumSegments(); ++k) {
    unsigned int smallest = arrays.front().GetSegments()[k].size();
    for (const InputArray& a : arrays) smallest = std::min(smallest, a.GetSegments()[k].size());
    for (InputArray& a : arrays) {
      if (a.GetSegments()[k].size() > smallest) a.SplitSegment(k, smallest);
    }
  }
}

}  // namespace LumenUtility
