/** @file */
/// @class LumenUtility::PointerSet
/// PointerSet<T>: the subscriber sets of property bags: an ordered set of non-null T* in
/// ascending pointer order, each pointer at most once.
///
/// Members sit in a sorted vector, so the set can be constant-initialised (the process-wide set
/// must exist before any static subscriber attaches), and a walk asks for the member after the
/// one it last visited (NextAfter) instead of holding an iterator, so that subscribers may come
/// and go while they are being called.
/// Thread-safety: confine to one thread (GlobalSubscriberSet adds a lock). Ownership: the
/// pointers only; nothing is ever deleted.
#pragma once

#include <algorithm>
#include <cstddef>
#include <functional>
#include <vector>

namespace LumenUtility {

template <typename T>
class PointerSet {
 public:
  constexpr PointerSet() = default;

  /// Adds `member`; returns false (and changes nothing) for null or a pointer already present.
  bool Insert(T* member) {
    if (!member) return false;
    const auto at = std::lower_bound(m_members.begin(), m_members.end(), member, Less());
    if (at != m_members.end() && *at == member) return false;
    m_members.insert(at, member);
    return true;
  }
  /// Removes `member`; returns false when it was not present.
  bool Erase(T* member) {
    const auto at = std::lower_bound(m_members.begin(), m_members.end(), member, Less());
    if (at == m_members.end() || *at != member) return false;
    m_members.erase(at);
    return true;
  }
  /// True when `member` is in the set.
  bool Contains(const T* member) const {
    return std::binary_search(m_members.begin(), m_members.end(), member, Less());
  }
  /// The smallest member above `after` (the smallest of all when `after` is null), or null.
  T* NextAfter(const T* after) const {
    const auto at = after ? std::upper_bound(m_members.begin(), m_members.end(), after, Less())
                          : m_members.begin();
    return at == m_members.end() ? nullptr : *at;
  }
  /// Number of members.
  std::size_t Size() const { return m_members.size(); }
  /// True when the set has no members.
  bool Empty() const { return m_members.empty(); }

 private:
  /// The total order of pointers, defined even for pointers into unrelated objects.
  using Less = std::less<const T*>;

  std::vector<T*> m_members;
};

}  // namespace LumenUtility
