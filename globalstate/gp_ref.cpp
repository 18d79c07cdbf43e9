#include "lumen/globalstate/gp_ref.h"

#include <boost/make_shared.hpp>

#include "globalstate/value_text.h"

namespace LumenUtility {

template <class T>
GPRef<T>::~GPRef() = default;

template <class T>
Rigel::GenericParameter::Ptr GPRef<T>::create_default() const {
  return boost::make_shared<GPRef>();
}

template <class T>
Rigel::GenericParameter::Ptr GPRef<T>::clone() const {
  return boost::make_shared<GPRef>(*this);
}

template <class T>
bool GPRef<T>::is_same_type(const Ptr& other) const {
  return dynamic_cast<const GPRef*>(other.get()) != nullptr;
}

template <class T>
std::wstring GPRef<T>::value_to_string(bool) const {
  if (m_pArray == nullptr || m_index >= m_pArray->get_values().size()) return std::wstring();
  return ValueText(m_pArray->get_values()[m_index]);
}

template class GPRef<double>;
template class GPRef<std::int32_t>;
template class GPRef<std::wstring>;
template class GPRef<Vela::BYPASS_SWITCH_STATE>;

}  // namespace LumenUtility
