/** @file */
/// @class LumenUtility::DataMatrix
/// DataMatrix: the container in which measured complex data is handed around.
///
/// A set of NamedBuffers, all created with one length (BufferSize()), found by the S-parameter
/// they hold (a pair of physical port numbers: S21, S1_12), by name, by an alias of a name, by
/// a ratio of two names ("A/R1,1" is buffer "A,1" divided by buffer "R1,1") or by a buffer's
/// auxiliary name. A matrix for an N-port measurement holds the N x N S-parameter buffers of
/// its physical ports; one built from a list of names holds a buffer per name.
///
/// Ranged reads and writes take the half-open sample range [start, stop); stop = -1 means
/// BufferSize(). A call with start = 0 and stop = BufferSize() is a whole-buffer call: the
/// output vector is assigned the buffer's whole sample vector, whatever its length. Any other
/// range copies samples start ... stop-1 to the same positions of an output that must already
/// hold at least stop elements, leaving its other elements as they were. A range is never read
/// beyond the buffer's own samples, which can be fewer than BufferSize() (a buffer set whole
/// from a shorter vector, or one left from before a larger Resize). Lookups that fail, and
/// ranges that do not fit (start > stop, an output or a buffer too short), return false (or
/// null) and leave the output untouched.
///
/// Thread-safety: a plain value; confine each object to one thread. Copies are deep.
#pragma once

#include <map>
#include <set>
#include <string>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/data/named_buffer.h"
#include "lumen/export.h"

namespace LumenUtility {

class LUMEN_API DataMatrix {
 public:
  /// No buffers, aliases or ports; buffer size 0, valid index -1.
  DataMatrix();
  /// Maps logical port i to physical port physicalPorts[i] and creates the nports x nports
  /// S-parameter buffers of `size` zero samples (see Resize); valid index 0. Throws
  /// LumenException 0x80004005 when physicalPorts holds fewer than nports entries or size < 0.
  DataMatrix(int nports, std::vector<int> physicalPorts, int size);
  /// One buffer of `size` zero samples per name, in order (a repeated name is created again);
  /// no ports are mapped; valid index 0. Throws LumenException 0x80004005 when size < 0.
  DataMatrix(const std::vector<std::wstring>& names, int size);

  /// Stores a fresh buffer of BufferSize() zero samples under `name`, replacing any buffer of
  /// that name (with its samples and aux name).
  void AddBuffer(const std::wstring& name);
  /// Sets BufferSize() to `size`, then for every logical pair (i, j) below nports (i outer)
  /// stores a fresh buffer of `size` zero samples named after the physical ports of i and j,
  /// replacing any buffer of that name. Other buffers keep their samples and length;
  /// nports < 1 only sets the size. Throws LumenException 0x80004005, with nothing changed,
  /// when the port list holds fewer than nports entries or size < 0.
  void Resize(int nports, int size);
  /// Makes `alias` stand for the buffer name `name` (replacing an earlier target of the alias).
  /// Aliases are followed one level deep.
  void AddAlias(const wchar_t* alias, const wchar_t* name);
  /// Stores auxName on the buffer of exactly that name (aliases are not followed). Returns
  /// false when there is no such buffer.
  bool SetAuxNameByName(const wchar_t* name, std::wstring auxName);
  /// A marker kept for callers; the matrix never interprets it.
  void SetValidIndex(int index) { m_validIndex = index; }
  /// The marker last set by SetValidIndex.
  int GetValidIndex() const { return m_validIndex; }

  /// Number of buffers.
  int Size() const { return static_cast<int>(m_buffers.size()); }
  /// Number of samples every buffer created by the matrix receives.
  int BufferSize() const { return m_bufferSize; }
  /// Physical port number of each logical port, indexed by logical port.
  const std::vector<int>& GetPhysicalPorts() const { return m_physicalPorts; }
  /// True when every port number in the set is a mapped physical port (true for none).
  bool HasPortMapping(const std::set<int>& ports) const;

  /// The buffer of logical ports (i, j); when i = j = 0 and the matrix holds exactly one
  /// buffer, that buffer whatever its name. Throws LumenException 0x80004005 when i or j is
  /// not a logical port index or the buffer does not exist.
  NamedBuffer& operator()(int i, int j);

  /// The buffer of physical ports (a, b); false unless both are mapped ports and the range
  /// lies within BufferSize() (start < BufferSize(), stop <= BufferSize()).
  bool GetDataByPhysicalPort(int a, int b, std::vector<TsComplex>& out, int start = 0,
                             int stop = -1) const;
  /// *out = the buffer's sample vector.
  bool GetDataByPhysicalPort(int a, int b, const std::vector<TsComplex>** out) const;
  /// *out = the address of sample `start`; *out is null after every failure.
  bool GetDataByPhysicalPort(int a, int b, const TsComplex** out, int start, int stop) const;
  /// Writes `in` into the buffer: the whole vector (any length) for a whole-buffer call, else
  /// in[start ... stop-1] into the same positions (`in` and the buffer must reach stop).
  bool SetDataByPhysicalPort(int a, int b, const std::vector<TsComplex>& in, int start = 0,
                             int stop = -1);

  ///@{
  /// The first buffer in name order; false when there is none or the range lies outside
  /// BufferSize().
  bool GetFirstBuffer(std::vector<TsComplex>& out, int start = 0, int stop = -1) const;
  bool GetFirstBuffer(const std::vector<TsComplex>** out) const;
  ///@}

  /// The buffer of that name after following an alias, or else the ratio name
  /// numerator/denominator,suffix: buffer numerator+suffix divided sample by sample by buffer
  /// denominator+suffix (each name alias-followed). A zero denominator sample gives 0 + 0j.
  /// A whole-buffer ratio covers the numerator's samples and needs a denominator at least as
  /// long.
  bool GetDataByName(const wchar_t* name, std::vector<TsComplex>& out, int start = 0,
                     int stop = -1) const;
  /// The first sample of the buffer of that name (alias followed, no ratios), or null when
  /// there is no such buffer or it has no samples.
  TsComplex* GetDataByName(const wchar_t* name) const;
  /// out = the sample vector of the buffer of that name (alias followed, no ratios).
  bool GetPointerToDataByName(const wchar_t* name, const std::vector<TsComplex>*& out) const;
  /// The first buffer in name order whose aux name equals auxName exactly (an empty auxName
  /// finds the first buffer without one).
  bool GetDataByAuxName(const wchar_t* auxName, std::vector<TsComplex>& out, int start = 0,
                        int stop = -1) const;

  /// Writes every buffer, in name order, as one line "TsComplex,<name>,re,im,re,im..." with
  /// CR LF line ends (a buffer without samples: "TsComplex,<name>"). Names are written in UTF-8,
  /// numbers with 6 significant digits (0.5, -0.25, 1e-07). Returns false, leaving no file
  /// behind, when the file cannot be created or written.
  bool DumpData(const char* path) const;

 private:
  /// "S%d%d" when both port numbers are below 10, else "S%d_%d".
  static std::wstring sparameter(int a, int b);
  /// The target of `name` when it is an alias, else `name`.
  std::wstring LookupAlias(const std::wstring& name) const;
  /// The buffer sparameter(i, j) with the numbers as given, without a port check.
  bool GetDataByLogicalPort(int i, int j, std::vector<TsComplex>& out, int start, int stop) const;

  const NamedBuffer* FindBuffer(const std::wstring& name) const;
  const NamedBuffer* FindPhysical(int a, int b) const;
  int ResolveStop(int stop) const { return stop == -1 ? m_bufferSize : stop; }
  bool WithinBufferSize(int start, int stop) const;
  bool CopyRange(const std::vector<TsComplex>& samples, std::vector<TsComplex>& out, int start,
                 int stop) const;
  bool CopyRatio(const std::vector<TsComplex>& numerator, const std::vector<TsComplex>& denominator,
                 std::vector<TsComplex>& out, int start, int stop) const;

  std::map<std::wstring, NamedBuffer> m_buffers;
  std::map<std::wstring, std::wstring> m_aliases;
  std::vector<int> m_physicalPorts;
  std::map<int, int> m_portToLogical;
  int m_validIndex;
  int m_bufferSize;
};

}  // namespace LumenUtility
