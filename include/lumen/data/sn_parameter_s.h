/** @file */
/// @class CSNParameterS
/// CSNParameterS: the traces of an n-port network, one per matrix position, plus optional
/// noise traces.
///
/// Position (row r, column c), both counted from 1, is entry (r - 1) * n + (c - 1). A copyable
/// value; confine each object to one thread.
#pragma once

#include <vector>

#include "lumen/data/sn_parameter.h"
#include "lumen/data/snp_types.h"
#include "lumen/export.h"

class LUMEN_API CSNParameterS {
 public:
  /// `ports` empty traces squared. Precondition: 1 <= ports <= 999.
  explicit CSNParameterS(SNPType ports = SNP_2PORT);

  /// Port count n.
  SNPType GetSNPType() const { return m_ports; }
  /// Number of matrix traces, n * n.
  int GetMaxNumParams() const { return static_cast<int>(m_params.size()); }

  /// True (the default) when a two-port file lists its pairs as 11, 21, 12, 22; false for
  /// 11, 12, 21, 22.
  bool Get2PortDataOrder() const { return m_twoPortOrder21; }
  /// Sets the two-port pair order read by Get2PortDataOrder.
  void Set2PortDataOrder(bool order21) { m_twoPortOrder21 = order21; }

  ///@{
  /// The trace at matrix index `index`. Throws std::out_of_range for index >= n * n.
  CSNParameter& GetParam(ESNParam index) { return m_params.at(static_cast<int>(index)); }
  const CSNParameter& GetParam(ESNParam index) const {
    return m_params.at(static_cast<int>(index));
  }
  ///@}
  ///@{
  /// The trace the k-th pair of a file's data line belongs to. For two ports with the order
  /// flag true, k = 1 and 2 are S21 and S12; a k outside 0..3 gives S11. For other port
  /// counts the file order is the matrix order (std::out_of_range for k >= n * n).
  CSNParameter& GetLoopParam(int k) { return m_params.at(LoopIndex(k)); }
  const CSNParameter& GetLoopParam(int k) const { return m_params.at(LoopIndex(k)); }
  ///@}

  /// Number of custom traces.
  int GetNumCustomParams() const { return static_cast<int>(m_customParams.size()); }
  /// Custom trace i (noise data: 0 NFmin, 1 GammaOpt, 2 Rn), growing the list to i + 1
  /// entries when needed. Precondition: i >= 0.
  CSNParameter& GetCustomParam(int i);
  /// Custom trace i; std::out_of_range for i outside 0 .. GetNumCustomParams() - 1.
  const CSNParameter& GetCustomParam(int i) const { return m_customParams.at(i); }

 protected:
  /// Matrix index of the k-th pair of a data line (see GetLoopParam).
  int LoopIndex(int k) const;

  /// The n * n matrix traces, row by row.
  std::vector<CSNParameter> m_params;
  /// Port count n.
  SNPType m_ports;
  /// Two-port pair order (see Get2PortDataOrder).
  bool m_twoPortOrder21 = true;
  /// Custom traces (noise data).
  std::vector<CSNParameter> m_customParams;
};
