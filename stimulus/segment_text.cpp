// Text form of a segment: "LIN,n,start,stop", "LOG,n,start,stop", "FIX,n,value",
// "ARB,n,p0,p1,...". Fields are separated by exactly one character.
#include <istream>
#include <ostream>
#include <string>

#include "lumen/stimulus/segment.h"

namespace LumenUtility {
namespace {

constexpr const wchar_t* kTokens[] = {L"LIN", L"LOG", L"FIX", L"ARB"};

// Consumes the one separator character that follows a field.
void SkipSeparator(std::wistream& is) {
  is.get();
}

}  // namespace

std::wostream& operator<<(std::wostream& os, const Segment& s) {
  os << kTokens[s.GetType() & 3] << L',' << s.size();
  switch (s.GetType()) {
    case Linear:
    case Log:
      os << L',' << s.m_start << L',' << s.m_stop;
      break;
    case Fixed:
      os << L',' << s.m_start;
      break;
    case Arbitrary:
      for (unsigned int i = 0; i < s.size(); ++i) os << L',' << s.at(i);
      break;
  }
  return os;
}

std::wistream& operator>>(std::wistream& is, Segment& s) {
  is >> std::ws;
  std::wstring token;
  while (token.size() < 3 && is.good() && is.peek() != L',') {
    token.push_back(static_cast<wchar_t>(is.get()));
  }
  int type = -1;
  for (int t = 0; t < 4; ++t) {
    if (token == kTokens[t]) type = t;
  }
  if (type < 0 || !is.good()) {
    is.setstate(std::ios::failbit);
    return is;
  }
  SkipSeparator(is);
  unsigned int n = 0;
  is >> n;
  if (type == Linear || type == Log) {
    double start = 0, stop = 0;
    SkipSeparator(is);
    is >> start;
    SkipSeparator(is);
    is >> stop;
    if (!is.fail()) s.SetSegment(start, stop, n, static_cast<SegmentType>(type));
  } else if (type == Fixed) {
    double value = 0;
    SkipSeparator(is);
    is >> value;
    if (!is.fail()) s.SetSegment(value, n);
  } else {
    // The count is untrusted text: grow with what is actually read.
    std::vector<double> points;
    for (unsigned int i = 0; i < n && !is.fail(); ++i) {
      double value = 0;
      SkipSeparator(is);
      is >> value;
      if (!is.fail()) points.push_back(value);
    }
    if (!is.fail()) s.SetSegment(points);
  }
  return is;
}

}  // namespace LumenUtility
