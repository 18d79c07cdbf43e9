/// @file
/// Enumerations of the Touchstone reader: port counts, trace indices, value forms, what the
/// stimulus column holds and the sweep the data came from.
#pragma once

/// Number of ports of a network; the enumerator's value is the port count, and any count
/// from 1 to 999 may be cast to it.
enum SNPType : int {
  SNP_1PORT = 1,
  SNP_2PORT = 2,
  SNP_3PORT = 3,
  SNP_4PORT = 4,
};

/// Index of a matrix position in a CSNParameterS: (row - 1) * ports + (column - 1), rows and
/// columns counted from 1. The named values are the two-port ones.
enum ESNParam : int {
  SNP_S11 = 0,
  SNP_S12 = 1,
  SNP_S21 = 2,
  SNP_S22 = 3,
};

/// How a Touchstone file writes one complex value as a pair (a, b).
enum ESNPForm : int {
  SNP_RI = 0,  ///< real, imaginary
  SNP_MA = 1,  ///< linear magnitude, angle in degrees
  SNP_DB = 2,  ///< 20*log10 magnitude, angle in degrees
};

/// What the stimulus column of a file holds.
enum ResultType : int {
  RESULT_FREQUENCY = 0,  ///< Hz (default)
  RESULT_SEC = 1,        ///< seconds
  RESULT_DBM = 2,        ///< power in dBm
  RESULT_POINT = 3,      ///< point numbers
};

/// The kind of sweep the data was measured with; set by the caller, never by the reader.
enum SweepTypeEnum : int {
  SWEEP_UNSPECIFIED = 0,
  SWEEP_LOG_FREQUENCY = 1,  ///< "Log Frequency Sweep"
  SWEEP_POWER = 2,          ///< "Power Sweep"
  SWEEP_CW_TIME = 3,        ///< "CW Time Sweep"
  SWEEP_PHASE = 5,          ///< "Phase Sweep"
};

/// Layout of the matrix in a file's data: every position, or one triangle of a symmetric
/// matrix (the other triangle mirrors it).
enum SnPMatrixFormat : int {
  SNP_MATRIX_FULL = 0,
  SNP_MATRIX_LOWER = 1,
  SNP_MATRIX_UPPER = 2,
};
