#include "lumen/data/sn_parameter_s.h"

#include <stdexcept>

#include "lumen/data/snp_file_base.h"

CSNParameterS::CSNParameterS(SNPType ports) : m_ports(ports) {
  if (ports < 1 || ports > CSnPFileBase::kMaxPorts) {
    throw std::invalid_argument("CSNParameterS: port count outside 1 to 999");
  }
  m_params.resize(static_cast<std::size_t>(ports) * static_cast<std::size_t>(ports));
}

int CSNParameterS::LoopIndex(int k) const {
  if (m_ports != SNP_2PORT) return k;
  switch (k) {
    case 1:
      return m_twoPortOrder21 ? 2 : 1;
    case 2:
      return m_twoPortOrder21 ? 1 : 2;
    case 3:
      return 3;
    default:
      return 0;
  }
}

CSNParameter& CSNParameterS::GetCustomParam(int i) {
  if (i < 0) throw std::out_of_range("CSNParameterS::GetCustomParam: negative index");
  if (static_cast<std::size_t>(i) >= m_customParams.size()) m_customParams.resize(i + 1);
  return m_customParams[i];
}
