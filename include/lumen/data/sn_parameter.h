/** @file */
/// @class CSNParameter
/// CSNParameter: one trace of a Touchstone file, a list of complex values on its own stimulus
/// points, with a name such as "S21".
///
/// A plain copyable value. Thread-safety: confine each object to one thread; copies share the
/// stimulus points copy-on-write and may live on different threads.
#pragma once

#include <string>
#include <vector>

#include "lumen/core/ts_complex.h"
#include "lumen/data/snp_types.h"
#include "lumen/export.h"
#include "lumen/stimulus/input_array.h"

class LUMEN_API CSNParameter {
 public:
  /// Everything empty.
  CSNParameter() = default;
  /// Both value vectors sized to stimulus.size() and filled with (0, 0); the stimulus itself
  /// stays empty until LoadSNP or Interpolate sets it.
  explicit CSNParameter(const LumenUtility::InputArray& stimulus);

  /// First and last stimulus value (Hz, or the file's own stimulus unit). Throw
  /// LumenException(E_FAIL) when the trace has no stimulus points.
  double GetStartFreq() const { return m_stimulus.front(); }
  /// Last stimulus point; LumenException(E_FAIL) when the trace has no stimulus points.
  double GetStopFreq() const { return m_stimulus.back(); }
  /// Number of stimulus points.
  int GetNumPoints() const { return static_cast<int>(m_stimulus.size()); }

  /// Sets the stimulus to `stimulus`, then data[i] from the pair (a[i], b[i]) as `form`
  /// says, for i below the smallest of data.size(), a.size() and b.size(). The data must
  /// already have its size (the constructor from an InputArray gives it). A form outside
  /// ESNPForm only sets the stimulus.
  void LoadSNP(std::vector<float>& a, std::vector<float>& b,
               const LumenUtility::InputArray& stimulus, ESNPForm form);

  /// Moves the trace onto `stimulus` (same unit as the trace's) by circular interpolation
  /// and keeps the name. Where `stimulus` reaches outside the trace's first or last point the
  /// whole trace becomes (0, 0) (widen it first with CSnPFileBase::ExtroplateReadSNPFile).
  /// With `reset` the spare data become stimulus.size() zeros and the spare stimulus empty;
  /// without it they stay as they were. A trace without data or stimulus points, and any trace
  /// when `stimulus` is empty, is left untouched.
  void Interpolate(const LumenUtility::InputArray& stimulus, bool reset);

  /// One complex value from a file's pair: RI (a, b); MA a at b degrees; DB 10^(a/20) at
  /// b degrees. Any other form gives (0, 0).
  static LumenUtility::TsComplex FromPair(float a, float b, ESNPForm form);

  ///@{
  /// The values, one per stimulus point.
  std::vector<LumenUtility::TsComplex>& GetData() { return m_data; }
  const std::vector<LumenUtility::TsComplex>& GetData() const { return m_data; }
  ///@}
  /// The stimulus points (Hz for frequency data).
  const LumenUtility::InputArray& GetStimulus() const { return m_stimulus; }
  /// Replaces the stimulus points; the values are not resized.
  void SetStimulus(const LumenUtility::InputArray& stimulus) { m_stimulus = stimulus; }
  /// The trace name, such as "S21".
  const std::wstring& GetName() const { return m_name; }
  /// Renames the trace.
  void SetName(const std::wstring& name) { m_name = name; }

  ///@{
  /// A second value vector and stimulus carried along for callers that pair the trace with
  /// other data; sized with the trace, never read here.
  std::vector<LumenUtility::TsComplex>& GetSpareData() { return m_spareData; }
  const std::vector<LumenUtility::TsComplex>& GetSpareData() const { return m_spareData; }
  ///@}
  ///@{
  /// A stimulus kept beside the trace for callers; never read here.
  LumenUtility::InputArray& GetSpareStimulus() { return m_spareStimulus; }
  const LumenUtility::InputArray& GetSpareStimulus() const { return m_spareStimulus; }
  ///@}

 private:
  std::vector<LumenUtility::TsComplex> m_data;
  std::vector<LumenUtility::TsComplex> m_spareData;
  LumenUtility::InputArray m_stimulus;
  LumenUtility::InputArray m_spareStimulus;
  std::wstring m_name;
};
