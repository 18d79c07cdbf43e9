/** @file */
/// @class LumenUtility::GPScalar
/// GPScalar<T>: one typed value of an acquisition parameter, such as the double "Freq" of a
/// source element or the text "RefSel" of the path manager.
///
/// Instantiated for double, std::int32_t, std::wstring and Vela::BYPASS_SWITCH_STATE (the
/// library provides these four; no other T links). Handed around as
/// boost::shared_ptr<Rigel::GenericParameter>.
/// Thread-safety: confine each object to one thread. Ownership: a plain value.
#pragma once

#include <string>
#include <vector>

#include "lumen/export.h"
#include "lumen/platform/rigel/bypass_switch_state.h"
#include "lumen/platform/rigel/generic_parameter.h"

namespace LumenUtility {

template <class T>
class LUMEN_API GPScalar : public Rigel::GenericParameter {
 public:
  /// An unnamed value T() (0.0 for double).
  GPScalar() = default;
  /// A value T() named `name`.
  explicit GPScalar(std::wstring name) : GenericParameter(std::move(name)) {}
  /// `value` named `name`.
  GPScalar(std::wstring name, T value)
      : GenericParameter(std::move(name)), m_value(std::move(value)) {}
  ///@{
  /// Copies name, change flag and value.
  GPScalar(const GPScalar&) = default;
  GPScalar& operator=(const GPScalar&) = default;
  ///@}
  ~GPScalar() override;

  /// The value.
  const T& get_value() const { return m_value; }
  /// Replaces the value; the change flag is left as it is.
  void set_value(T value) { m_value = std::move(value); }

  /// "GPScalar<" type "> " name " " value.
  std::wstring to_string(bool brief) const override;
  std::wstring value_type_to_string() const override;
  Ptr create_default() const override;
  Ptr clone() const override;
  /// True for this very object, or for a GPScalar<T> of the same name and an equal value.
  bool IsEqual(const Rigel::GenericParameter& other) const override;
  bool is_same_type(const Ptr& other) const override;
  /// A new GPArray<T> named as this value, holding the values of `list` in order, its count
  /// their number. An empty pointer when an element of `list` is not a GPScalar<T> (an empty
  /// element included): such an element has no value of type T to give.
  Ptr FromVectorToGPPtr(std::vector<Ptr>& list) override;
  /// The value alone, as a wide stream writes it by default: 6e+09 for 6000000000.0, a text as
  /// it is, the switch state as its number.
  std::wstring value_to_string(bool brief) const override;

 private:
  T m_value{};
};

extern template class GPScalar<double>;
extern template class GPScalar<std::int32_t>;
extern template class GPScalar<std::wstring>;
extern template class GPScalar<Vela::BYPASS_SWITCH_STATE>;

}  // namespace LumenUtility
