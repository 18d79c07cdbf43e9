#include "lumen/core/natural_compare.h"

#include <cwctype>

namespace LumenUtility {

namespace {

bool IsDigit(wchar_t c) {
  return c >= L'0' && c <= L'9';
}

bool IsSpace(wchar_t c) {
  return c != L'\0' && std::iswspace(static_cast<wint_t>(c)) != 0;
}

// Digit runs read as integers: the longer run is larger; between runs of equal length the
// first differing digit decides.
int CompareRightAligned(const wchar_t* a, const wchar_t* b) {
  int bias = 0;
  for (;; ++a, ++b) {
    const bool moreA = IsDigit(*a);
    const bool moreB = IsDigit(*b);
    if (!moreA && !moreB) return bias;
    if (!moreA) return -1;
    if (!moreB) return 1;
    if (bias == 0 && *a != *b) bias = *a < *b ? -1 : 1;
  }
}

// Digit runs read as fractions: the first differing digit decides; a run that ends first is
// smaller.
int CompareLeftAligned(const wchar_t* a, const wchar_t* b) {
  for (;; ++a, ++b) {
    const bool moreA = IsDigit(*a);
    const bool moreB = IsDigit(*b);
    if (!moreA && !moreB) return 0;
    if (!moreA) return -1;
    if (!moreB) return 1;
    if (*a != *b) return *a < *b ? -1 : 1;
  }
}

wchar_t Upper(wchar_t c) {
  return static_cast<wchar_t>(std::towupper(static_cast<wint_t>(c)));
}

int Compare(const wchar_t* a, const wchar_t* b, bool foldCase) {
  if (a == nullptr) a = L"";
  if (b == nullptr) b = L"";
  for (;; ++a, ++b) {
    while (IsSpace(*a)) ++a;
    while (IsSpace(*b)) ++b;
    wchar_t ca = *a;
    wchar_t cb = *b;
    if (IsDigit(ca) && IsDigit(cb)) {
      const int result =
          (ca == L'0' || cb == L'0') ? CompareLeftAligned(a, b) : CompareRightAligned(a, b);
      if (result != 0) return result;
    }
    if (ca == L'\0' && cb == L'\0') return 0;
    if (foldCase) {
      ca = Upper(ca);
      cb = Upper(cb);
    }
    if (ca != cb) return ca < cb ? -1 : 1;
  }
}

}  // namespace

int strnatcmp(const wchar_t* a, const wchar_t* b) {
  return Compare(a, b, false);
}

int strnatcmpNoCase(const wchar_t* a, const wchar_t* b) {
  return Compare(a, b, true);
}

}  // namespace LumenUtility
