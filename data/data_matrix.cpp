#include "lumen/data/data_matrix.h"

#include <algorithm>
#include <cfloat>
#include <cstddef>
#include <string>
#include <utility>

#include "lumen/platform/error_codes.h"
#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {

namespace {

// Stands in for the squared magnitude of a zero denominator sample (the smallest normal
// float), so that a finite numerator gives 0 + 0j rather than NaN.
constexpr float kZeroDenominatorGuard = FLT_MIN;

TsComplex Quotient(const TsComplex& num, const TsComplex& den) {
  float d = den.re * den.re + den.im * den.im;
  if (d == 0.0f) d = kZeroDenominatorGuard;
  TsComplex q;
  q.re = (num.re * den.re + num.im * den.im) / d;
  q.im = (num.im * den.re - num.re * den.im) / d;
  return q;
}

bool Reaches(const std::vector<TsComplex>& v, int stop) {
  return static_cast<std::size_t>(stop) <= v.size();
}

std::wstring NameOf(const wchar_t* name) {
  return name != nullptr ? std::wstring(name) : std::wstring();
}

}  // namespace

DataMatrix::DataMatrix() : m_validIndex(-1), m_bufferSize(0) {}

DataMatrix::DataMatrix(int nports, std::vector<int> physicalPorts, int size)
    : m_physicalPorts(std::move(physicalPorts)), m_validIndex(0), m_bufferSize(0) {
  Resize(nports, size);
  for (int i = 0; i < nports; ++i) m_portToLogical[m_physicalPorts[i]] = i;
}

DataMatrix::DataMatrix(const std::vector<std::wstring>& names, int size)
    : m_validIndex(0), m_bufferSize(size) {
  if (size < 0) throw LumenException(E_FAIL, L"DataMatrix: negative buffer size");
  for (const std::wstring& name : names) AddBuffer(name);
}

void DataMatrix::AddBuffer(const std::wstring& name) {
  NamedBuffer buffer(name);
  buffer.SetData(std::vector<TsComplex>(m_bufferSize));
  m_buffers.insert_or_assign(name, std::move(buffer));
}

void DataMatrix::Resize(int nports, int size) {
  if (size < 0) throw LumenException(E_FAIL, L"DataMatrix: negative buffer size");
  if (nports > static_cast<int>(m_physicalPorts.size())) {
    throw LumenException(E_FAIL, L"DataMatrix: fewer physical ports than the port count");
  }
  m_bufferSize = size;
  for (int i = 0; i < nports; ++i) {
    for (int j = 0; j < nports; ++j) AddBuffer(sparameter(m_physicalPorts[i], m_physicalPorts[j]));
  }
}

void DataMatrix::AddAlias(const wchar_t* alias, const wchar_t* name) {
  m_aliases[NameOf(alias)] = NameOf(name);
}

bool DataMatrix::SetAuxNameByName(const wchar_t* name, std::wstring auxName) {
  const auto found = m_buffers.find(NameOf(name));
  if (found == m_buffers.end()) return false;
  found->second.m_hasAuxName = !auxName.empty();
  found->second.m_auxName = std::move(auxName);
  return true;
}

bool DataMatrix::HasPortMapping(const std::set<int>& ports) const {
  return std::all_of(ports.begin(), ports.end(),
                     [this](int port) { return m_portToLogical.count(port) != 0; });
}

NamedBuffer& DataMatrix::operator()(int i, int j) {
  if (i == 0 && j == 0 && m_buffers.size() == 1) return m_buffers.begin()->second;
  const int ports = static_cast<int>(m_physicalPorts.size());
  if (i < 0 || j < 0 || i >= ports || j >= ports) {
    throw LumenException(E_FAIL, L"DataMatrix: logical port index out of range");
  }
  const std::wstring name = sparameter(m_physicalPorts[i], m_physicalPorts[j]);
  const auto found = m_buffers.find(name);
  if (found == m_buffers.end()) throw LumenException(E_FAIL, L"DataMatrix: no buffer " + name);
  return found->second;
}

bool DataMatrix::GetDataByPhysicalPort(int a, int b, std::vector<TsComplex>& out, int start,
                                       int stop) const {
  const NamedBuffer* buffer = FindPhysical(a, b);
  stop = ResolveStop(stop);
  return buffer != nullptr && WithinBufferSize(start, stop) &&
         CopyRange(buffer->m_data, out, start, stop);
}

bool DataMatrix::GetDataByPhysicalPort(int a, int b, const std::vector<TsComplex>** out) const {
  const NamedBuffer* buffer = FindPhysical(a, b);
  if (buffer == nullptr) return false;
  *out = &buffer->m_data;
  return true;
}

bool DataMatrix::GetDataByPhysicalPort(int a, int b, const TsComplex** out, int start,
                                       int stop) const {
  *out = nullptr;
  const NamedBuffer* buffer = FindPhysical(a, b);
  stop = ResolveStop(stop);
  // The caller reads up to stop through the pointer, so the buffer itself must reach it.
  if (buffer == nullptr || !WithinBufferSize(start, stop) || start < 0 || start > stop ||
      !Reaches(buffer->m_data, stop) || buffer->m_data.empty()) {
    return false;
  }
  *out = buffer->m_data.data() + start;
  return true;
}

bool DataMatrix::SetDataByPhysicalPort(int a, int b, const std::vector<TsComplex>& in, int start,
                                       int stop) {
  if (FindPhysical(a, b) == nullptr) return false;
  NamedBuffer& buffer = m_buffers.find(sparameter(a, b))->second;
  stop = ResolveStop(stop);
  if (!WithinBufferSize(start, stop)) return false;
  if (start == 0 && stop == m_bufferSize) {
    buffer.SetData(in);
    return true;
  }
  if (start < 0 || start > stop || !Reaches(in, stop) || !Reaches(buffer.m_data, stop)) {
    return false;
  }
  std::copy(in.begin() + start, in.begin() + stop, buffer.m_data.begin() + start);
  return true;
}

bool DataMatrix::GetDataByLogicalPort(int i, int j, std::vector<TsComplex>& out, int start,
                                      int stop) const {
  const NamedBuffer* buffer = FindBuffer(sparameter(i, j));
  stop = ResolveStop(stop);
  return buffer != nullptr && WithinBufferSize(start, stop) &&
         CopyRange(buffer->m_data, out, start, stop);
}

bool DataMatrix::GetFirstBuffer(std::vector<TsComplex>& out, int start, int stop) const {
  stop = ResolveStop(stop);
  return !m_buffers.empty() && WithinBufferSize(start, stop) &&
         CopyRange(m_buffers.begin()->second.m_data, out, start, stop);
}

bool DataMatrix::GetFirstBuffer(const std::vector<TsComplex>** out) const {
  if (m_buffers.empty()) return false;
  *out = &m_buffers.begin()->second.m_data;
  return true;
}

bool DataMatrix::GetDataByName(const wchar_t* name, std::vector<TsComplex>& out, int start,
                               int stop) const {
  stop = ResolveStop(stop);
  const std::wstring key = LookupAlias(NameOf(name));
  if (const NamedBuffer* buffer = FindBuffer(key))
    return CopyRange(buffer->m_data, out, start, stop);

  const std::size_t slash = key.find(L'/');
  const std::size_t comma = key.find(L',');
  if (slash == std::wstring::npos || comma == std::wstring::npos) return false;
  const std::wstring suffix = key.substr(comma);
  const NamedBuffer* numerator = FindBuffer(LookupAlias(key.substr(0, slash) + suffix));
  // A "/" after the "," leaves no denominator name between them: no such ratio.
  const NamedBuffer* denominator =
      slash < comma ? FindBuffer(LookupAlias(key.substr(slash + 1, comma - slash - 1) + suffix))
                    : nullptr;
  if (numerator == nullptr || denominator == nullptr) return false;
  return CopyRatio(numerator->m_data, denominator->m_data, out, start, stop);
}

TsComplex* DataMatrix::GetDataByName(const wchar_t* name) const {
  const NamedBuffer* buffer = FindBuffer(LookupAlias(NameOf(name)));
  return buffer != nullptr ? buffer->m_pData : nullptr;
}

bool DataMatrix::GetPointerToDataByName(const wchar_t* name,
                                        const std::vector<TsComplex>*& out) const {
  const NamedBuffer* buffer = FindBuffer(LookupAlias(NameOf(name)));
  if (buffer == nullptr) return false;
  out = &buffer->m_data;
  return true;
}

bool DataMatrix::GetDataByAuxName(const wchar_t* auxName, std::vector<TsComplex>& out, int start,
                                  int stop) const {
  const std::wstring wanted = NameOf(auxName);
  const auto found = std::find_if(m_buffers.begin(), m_buffers.end(), [&wanted](const auto& entry) {
    return entry.second.m_auxName == wanted;
  });
  return found != m_buffers.end() && CopyRange(found->second.m_data, out, start, ResolveStop(stop));
}

std::wstring DataMatrix::sparameter(int a, int b) {
  const std::wstring separator = (a < 10 && b < 10) ? L"" : L"_";
  return L"S" + std::to_wstring(a) + separator + std::to_wstring(b);
}

std::wstring DataMatrix::LookupAlias(const std::wstring& name) const {
  const auto found = m_aliases.find(name);
  return found != m_aliases.end() ? found->second : name;
}

const NamedBuffer* DataMatrix::FindBuffer(const std::wstring& name) const {
  const auto found = m_buffers.find(name);
  return found != m_buffers.end() ? &found->second : nullptr;
}

const NamedBuffer* DataMatrix::FindPhysical(int a, int b) const {
  if (m_portToLogical.count(a) == 0 || m_portToLogical.count(b) == 0) return nullptr;
  return FindBuffer(sparameter(a, b));
}

bool DataMatrix::WithinBufferSize(int start, int stop) const {
  return start < m_bufferSize && stop <= m_bufferSize;
}

bool DataMatrix::CopyRange(const std::vector<TsComplex>& samples, std::vector<TsComplex>& out,
                           int start, int stop) const {
  if (start == 0 && stop == m_bufferSize) {
    out = samples;
    return true;
  }
  if (start < 0 || start > stop || !Reaches(samples, stop) || !Reaches(out, stop)) return false;
  std::copy(samples.begin() + start, samples.begin() + stop, out.begin() + start);
  return true;
}

bool DataMatrix::CopyRatio(const std::vector<TsComplex>& numerator,
                           const std::vector<TsComplex>& denominator, std::vector<TsComplex>& out,
                           int start, int stop) const {
  if (start == 0 && stop == m_bufferSize) {
    // Whole-buffer: every numerator sample is divided, so none is left undivided.
    if (denominator.size() < numerator.size()) return false;
    out.resize(numerator.size());
    start = 0;
    stop = static_cast<int>(numerator.size());
  } else if (start < 0 || start > stop || !Reaches(numerator, stop) ||
             !Reaches(denominator, stop) || !Reaches(out, stop)) {
    return false;
  }
  for (int k = start; k < stop; ++k) out[k] = Quotient(numerator[k], denominator[k]);
  return true;
}

}  // namespace LumenUtility
