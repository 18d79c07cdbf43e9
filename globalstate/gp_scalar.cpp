#include "lumen/globalstate/gp_scalar.h"

#include <boost/make_shared.hpp>

#include "globalstate/value_text.h"
#include "lumen/globalstate/gp_array.h"

namespace LumenUtility {

template <class T>
GPScalar<T>::~GPScalar() = default;

template <class T>
std::wstring GPScalar<T>::to_string(bool brief) const {
  return L"GPScalar<" + value_type_to_string() + L"> " + name() + L" " + value_to_string(brief);
}

template <class T>
std::wstring GPScalar<T>::value_type_to_string() const {
  return ValueTypeText<T>();
}

template <class T>
Rigel::GenericParameter::Ptr GPScalar<T>::create_default() const {
  return boost::make_shared<GPScalar>();
}

template <class T>
Rigel::GenericParameter::Ptr GPScalar<T>::clone() const {
  return boost::make_shared<GPScalar>(*this);
}

template <class T>
bool GPScalar<T>::IsEqual(const Rigel::GenericParameter& other) const {
  if (&other == this) return true;
  if (other.name() != name()) return false;
  const auto* scalar = dynamic_cast<const GPScalar*>(&other);
  return scalar != nullptr && scalar->m_value == m_value;
}

template <class T>
bool GPScalar<T>::is_same_type(const Ptr& other) const {
  return dynamic_cast<const GPScalar*>(other.get()) != nullptr;
}

template <class T>
Rigel::GenericParameter::Ptr GPScalar<T>::FromVectorToGPPtr(std::vector<Ptr>& list) {
  std::vector<T> values;
  values.reserve(list.size());
  for (const Ptr& element : list) {
    const auto* scalar = dynamic_cast<const GPScalar*>(element.get());
    if (scalar == nullptr) return Ptr();
    values.push_back(scalar->m_value);
  }
  return boost::make_shared<GPArray<T>>(name(), std::move(values));
}

template <class T>
std::wstring GPScalar<T>::value_to_string(bool) const {
  return ValueText(m_value);
}

template class GPScalar<double>;
template class GPScalar<std::int32_t>;
template class GPScalar<std::wstring>;
template class GPScalar<Vela::BYPASS_SWITCH_STATE>;

}  // namespace LumenUtility
