#include "lumen/globalstate/gp_array.h"

#include <limits>
#include <stdexcept>

#include <boost/make_shared.hpp>

#include "globalstate/value_text.h"
#include "lumen/globalstate/gp_ref.h"

namespace LumenUtility {

namespace {

// The room that set_at leaves past the index it stores at.
constexpr std::size_t kSetAtSlack = 10;

}  // namespace

template <class T>
GPArray<T>::GPArray(std::wstring name, std::vector<T> values)
    : GenericParameter(std::move(name)), m_values(std::move(values)) {
  if (m_values.size() > std::numeric_limits<std::uint32_t>::max()) {
    throw std::length_error("GPArray: more values than a 32-bit count holds");
  }
  m_absent.assign(m_values.size(), false);
  m_count = static_cast<std::uint32_t>(m_values.size());
}

template <class T>
GPArray<T>::~GPArray() = default;

template <class T>
bool GPArray<T>::IsPresent(std::uint32_t index) const {
  return index < m_count && !m_absent[index];
}

template <class T>
void GPArray<T>::Grow(std::size_t stored) {
  m_values.resize(stored);
  m_absent.resize(stored, false);
}

template <class T>
Rigel::GenericParameter::Ptr GPArray<T>::at(std::uint32_t index) {
  if (!IsPresent(index)) return Ptr();
  return boost::make_shared<GPScalar<T>>(name(), m_values[index]);
}

template <class T>
Rigel::GenericParameter::Ptr GPArray<T>::referenced_at(std::uint32_t index) {
  if (!IsPresent(index)) return Ptr();
  return boost::make_shared<GPRef<T>>(name(), this, index);
}

template <class T>
void GPArray<T>::set_at(std::uint32_t index, const Ptr& value) {
  const auto* scalar = dynamic_cast<const GPScalar<T>*>(value.get());
  if (scalar == nullptr) return;
  if (index == std::numeric_limits<std::uint32_t>::max()) {
    throw std::length_error("GPArray::set_at: index 4294967295 leaves no room for the count");
  }
  // Sizes in 64 bits: index + 10 passes 2^32 for the last indices.
  if (index >= m_count && index >= m_values.size()) Grow(std::size_t{index} + kSetAtSlack);
  if (index >= m_count) m_count = index + 1;
  m_values[index] = scalar->get_value();
  set_change_flag();
}

template <class T>
void GPArray<T>::resize(std::uint32_t count) {
  if (count > m_values.size()) Grow(count);
  m_count = count;
}

template <class T>
std::wstring GPArray<T>::to_string(bool brief) const {
  return L"GPArray<" + value_type_to_string() + L"> " + name() + L"[" + std::to_wstring(m_count) +
         L"] " + value_to_string(brief);
}

template <class T>
std::wstring GPArray<T>::value_type_to_string() const {
  return ValueTypeText<T>();
}

template <class T>
Rigel::GenericParameter::Ptr GPArray<T>::create_default() const {
  return boost::make_shared<GPArray>();
}

template <class T>
Rigel::GenericParameter::Ptr GPArray<T>::clone() const {
  return boost::make_shared<GPArray>(*this);
}

template <class T>
bool GPArray<T>::IsEqual(const Rigel::GenericParameter& other) const {
  if (&other == this) return true;
  if (other.name() != name()) return false;
  const auto* array = dynamic_cast<const GPArray*>(&other);
  if (array == nullptr || array->m_count != m_count) return false;
  for (std::uint32_t i = 0; i < m_count; ++i) {
    if (m_absent[i] != array->m_absent[i]) return false;
    if (!m_absent[i] && !(m_values[i] == array->m_values[i])) return false;
  }
  return true;
}

template <class T>
bool GPArray<T>::is_same_type(const Ptr& other) const {
  return dynamic_cast<const GPArray*>(other.get()) != nullptr;
}

template <class T>
std::wstring GPArray<T>::value_to_string(bool brief) const {
  std::wstring text = L" [ ";
  if (!brief) {
    for (std::uint32_t i = 0; i < m_count; ++i) text += ValueText(m_values[i]) + L" ";
  }
  return text + L"]\n";
}

template <class T>
bool GPArray<T>::get_absent_flag(std::uint32_t index) const {
  return index < m_absent.size() && m_absent[index];
}

template <class T>
bool GPArray<T>::set_absent_flag(std::uint32_t index, bool absent) {
  if (index >= m_absent.size()) return false;
  m_absent[index] = absent;
  return true;
}

template class GPArray<double>;
template class GPArray<std::int32_t>;
template class GPArray<std::wstring>;
template class GPArray<Vela::BYPASS_SWITCH_STATE>;

}  // namespace LumenUtility
