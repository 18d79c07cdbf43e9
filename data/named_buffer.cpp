#include "lumen/data/named_buffer.h"

#include <utility>

namespace LumenUtility {

NamedBuffer::NamedBuffer(const wchar_t* name) : m_name(name != nullptr ? name : L"") {}

NamedBuffer::NamedBuffer(std::wstring name) : m_name(std::move(name)) {}

NamedBuffer::NamedBuffer(const NamedBuffer& other)
    : m_data(other.m_data),
      m_name(other.m_name),
      m_auxName(other.m_auxName),
      m_hasAuxName(other.m_hasAuxName) {
  RefreshPointer();
}

NamedBuffer& NamedBuffer::operator=(const NamedBuffer& other) {
  if (this != &other) {
    m_data = other.m_data;
    m_name = other.m_name;
    m_auxName = other.m_auxName;
    m_hasAuxName = other.m_hasAuxName;
    RefreshPointer();
  }
  return *this;
}

NamedBuffer::NamedBuffer(NamedBuffer&& other) noexcept
    : m_data(std::move(other.m_data)),
      m_name(std::move(other.m_name)),
      m_auxName(std::move(other.m_auxName)),
      m_hasAuxName(other.m_hasAuxName) {
  RefreshPointer();
  other.m_data.clear();
  other.RefreshPointer();
}

NamedBuffer& NamedBuffer::operator=(NamedBuffer&& other) noexcept {
  if (this != &other) {
    m_data = std::move(other.m_data);
    m_name = std::move(other.m_name);
    m_auxName = std::move(other.m_auxName);
    m_hasAuxName = other.m_hasAuxName;
    RefreshPointer();
    other.m_data.clear();
    other.RefreshPointer();
  }
  return *this;
}

void NamedBuffer::SetData(std::vector<TsComplex> samples) {
  m_data = std::move(samples);
  RefreshPointer();
}

}  // namespace LumenUtility
