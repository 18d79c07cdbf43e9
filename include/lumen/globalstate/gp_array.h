/** @file */
/// @class LumenUtility::GPArray
/// GPArray<T>: a list of typed values of one acquisition parameter, such as the frequencies of
/// every point.
///
/// The array stores values with one absent flag each, and a count of the elements in use; it
/// may store more values than it counts (shrinking keeps them). An absent element yields no
/// object. Nothing in this library sets an absent flag; the hardware layer may.
/// Instantiated for the four value types of GPScalar<T>.
/// Thread-safety: confine each object to one thread. Ownership: the array owns its values;
/// the references it hands out (referenced_at) point into it and must not outlive it.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "lumen/export.h"
#include "lumen/globalstate/gp_scalar.h"

namespace LumenUtility {

template <class T>
class LUMEN_API GPArray : public Rigel::GenericParameter {
 public:
  /// An unnamed empty array.
  GPArray() = default;
  /// An empty array named `name`.
  explicit GPArray(std::wstring name) : GenericParameter(std::move(name)) {}
  /// An array counting all of `values`, none absent. Throws std::length_error for 2^32 or more
  /// values (the count is 32-bit).
  GPArray(std::wstring name, std::vector<T> values);
  ///@{
  /// Copies the name, change flag, values and count.
  GPArray(const GPArray&) = default;
  GPArray& operator=(const GPArray&) = default;
  ///@}
  ~GPArray() override;

  /// A new GPScalar<T> with the array's name and a copy of element `index`; an empty pointer
  /// when index >= size() or the element is absent.
  Ptr at(std::uint32_t index) override;
  /// A new GPRef<T> with the array's name pointing at element `index` of this array; an empty
  /// pointer under the same conditions as at.
  Ptr referenced_at(std::uint32_t index) override;
  /// When `value` is a GPScalar<T>: stores its value at `index`, counting the array up to
  /// index + 1 when it was shorter (storage grows to index + 10 values, new ones T() and not
  /// absent, so that a run of appends does not grow it each time), and sets the change flag.
  /// A value of another type, or an empty one, changes nothing. Throws std::length_error for
  /// index 2^32 - 1, whose count would not fit in 32 bits, std::bad_alloc when memory runs out.
  void set_at(std::uint32_t index, const Ptr& value) override;
  /// The count of elements in use.
  std::uint32_t size() const override { return m_count; }
  std::uint32_t total_size() const override { return m_count; }
  /// Counts `count` elements; storage grows to `count` values when shorter (new ones T(), not
  /// absent) and never shrinks.
  void resize(std::uint32_t count) override;
  /// "GPArray<" type "> " name "[" count "] " and value_to_string(brief).
  std::wstring to_string(bool brief) const override;
  std::wstring value_type_to_string() const override;
  Ptr create_default() const override;
  Ptr clone() const override;
  /// True for this very object, or for a GPArray<T> of the same name and count whose counted
  /// elements match one by one: both absent, or both present with equal values. Values stored
  /// beyond the count do not take part.
  bool IsEqual(const Rigel::GenericParameter& other) const override;
  bool is_same_type(const Ptr& other) const override;
  /// " [ ", then (unless `brief`) each counted value followed by a blank, then "]" and a line
  /// end ("\n").
  std::wstring value_to_string(bool brief) const override;

  /// The stored values; the first size() of them are in use.
  const std::vector<T>& get_values() const { return m_values; }
  /// The absent flag of stored value `index`; false past the stored values.
  bool get_absent_flag(std::uint32_t index) const;
  /// Sets or clears the absent flag of stored value `index`; false, with nothing changed,
  /// past the stored values.
  bool set_absent_flag(std::uint32_t index, bool absent);

 private:
  bool IsPresent(std::uint32_t index) const;
  void Grow(std::size_t stored);

  std::vector<T> m_values;
  std::vector<bool> m_absent;
  std::uint32_t m_count = 0;
};

extern template class GPArray<double>;
extern template class GPArray<std::int32_t>;
extern template class GPArray<std::wstring>;
extern template class GPArray<Vela::BYPASS_SWITCH_STATE>;

}  // namespace LumenUtility
