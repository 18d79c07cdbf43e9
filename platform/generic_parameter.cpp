#include "lumen/platform/rigel/generic_parameter.h"

namespace Rigel {

bool GenericParameter::get_change_flag() const {
  return m_changeFlag;
}

void GenericParameter::set_change_flag() {
  m_changeFlag = true;
}

void GenericParameter::clear_change_flag() {
  m_changeFlag = false;
}

GenericParameter::~GenericParameter() = default;

GenericParameter::Ptr GenericParameter::at(std::uint32_t) {
  return Ptr();
}

GenericParameter::Ptr GenericParameter::referenced_at(std::uint32_t) {
  return Ptr();
}

void GenericParameter::set_at(std::uint32_t, const Ptr&) {}

bool GenericParameter::append(const Ptr&) {
  return false;
}

bool GenericParameter::insert(std::uint32_t, const Ptr&) {
  return false;
}

GenericParameter::Ptr GenericParameter::ptr_find(const std::wstring&) {
  return Ptr();
}

std::int32_t GenericParameter::pos_find(const std::wstring&) {
  return -1;
}

GenericParameter::Ptr GenericParameter::ptr_quick_search(const std::wstring&) {
  return Ptr();
}

bool GenericParameter::remove(std::uint32_t) {
  return false;
}

std::uint32_t GenericParameter::size() const {
  return 1;
}

std::uint32_t GenericParameter::total_size() const {
  return size();
}

void GenericParameter::resize(std::uint32_t) {}

std::wstring GenericParameter::to_string(bool brief) const {
  return m_name + L" " + value_to_string(brief);
}

std::wstring GenericParameter::value_type_to_string() const {
  return std::wstring();
}

bool GenericParameter::IsEqual(const GenericParameter& other) const {
  return &other == this;
}

GenericParameter::Ptr GenericParameter::FromVectorToGPPtr(std::vector<Ptr>&) {
  return Ptr();
}

}  // namespace Rigel
