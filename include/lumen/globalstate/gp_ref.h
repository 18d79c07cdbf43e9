/** @file */
/// @class LumenUtility::GPRef
/// GPRef<T>: names one element of a GPArray<T>, so that a parameter can follow a value that
/// the array holds; it shows whatever the element holds when it is asked.
///
/// Instantiated for the four value types of GPScalar<T>.
/// Thread-safety: confine each object, and its array, to one thread. Ownership: the reference
/// does not own its array, which must outlive it.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/export.h"
#include "lumen/globalstate/gp_array.h"

namespace LumenUtility {

template <class T>
class LUMEN_API GPRef : public Rigel::GenericParameter {
 public:
  /// An unnamed reference to no array.
  GPRef() = default;
  /// A reference named `name` to no array.
  explicit GPRef(std::wstring name) : GenericParameter(std::move(name)) {}
  /// Element `index` of `array` (which may be null).
  GPRef(std::wstring name, GPArray<T>* array, std::uint32_t index)
      : GenericParameter(std::move(name)), m_pArray(array), m_index(index) {}
  ///@{
  /// Copies name, change flag, array pointer and index (not the array).
  GPRef(const GPRef&) = default;
  GPRef& operator=(const GPRef&) = default;
  ///@}
  ~GPRef() override;

  /// The array referred to; may be null.
  GPArray<T>* get_array() const { return m_pArray; }
  /// The element index within the array.
  std::uint32_t get_index() const { return m_index; }

  Ptr create_default() const override;
  /// A reference to the same element of the same array.
  Ptr clone() const override;
  bool is_same_type(const Ptr& other) const override;
  /// The element's stored value alone, as GPScalar<T> writes it; an empty text when there is
  /// no array or the index lies past its stored values.
  std::wstring value_to_string(bool brief) const override;

 private:
  GPArray<T>* m_pArray = nullptr;
  std::uint32_t m_index = 0;
};

extern template class GPRef<double>;
extern template class GPRef<std::int32_t>;
extern template class GPRef<std::wstring>;
extern template class GPRef<Vela::BYPASS_SWITCH_STATE>;

}  // namespace LumenUtility
