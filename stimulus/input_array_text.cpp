// Text form of a stimulus array: "(" segments separated by line feeds ")".
#include <istream>
#include <ostream>

#include "lumen/stimulus/input_array.h"

namespace LumenUtility {

std::wostream& operator<<(std::wostream& os, const InputArray& a) {
  // 15 significant digits survive a round trip through double for stimulus values.
  const std::streamsize precision = os.precision(15);
  const std::ios::fmtflags flags = os.flags();
  os.unsetf(std::ios::showpoint);
  os << L'(';
  const std::vector<Segment>& segments = a.GetSegments();
  for (std::size_t k = 0; k < segments.size(); ++k) {
    if (k > 0) os << L'\n';
    os << segments[k];
  }
  os << L')';
  os.precision(precision);
  os.flags(flags);
  return os;
}

std::wistream& operator>>(std::wistream& is, InputArray& a) {
  if (is.peek() != L'(') {
    is.setstate(std::ios::failbit);
    return is;
  }
  is.get();
  InputArray parsed;
  while (is.good() && is.peek() != L')') {
    Segment s;
    is >> s;
    if (!is.fail()) parsed.push_back(s);
  }
  if (is.get() != L')') is.setstate(std::ios::failbit);
  if (!is.fail()) a = parsed;
  return is;
}

}  // namespace LumenUtility
