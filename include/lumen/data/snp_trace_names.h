/// @file
/// The names and matrix indices of the traces of an n-port network, shared by the Touchstone
/// reader, writers and tools so that every one of them names and finds a trace alike.
///
/// Trace (row r, column c), both counted from 1, is named "S" followed by r and c ("S21"), with
/// an underscore between them once either passes 9 ("S1_10", "S12_3"), and sits at matrix
/// index (r - 1) * n + (c - 1) of a CSNParameterS.
#pragma once

#include <string>
#include <string_view>

#include "lumen/export.h"

/// Matrix index of (row, column) in a network of `ports` ports. Precondition: both from 1 to
/// `ports`.
constexpr int SnPMatrixIndex(int ports, int row, int column) {
  return (row - 1) * ports + (column - 1);
}

/// The name of trace (row, column): "S21", "S1_10". Precondition: both from 1 to 999.
LUMEN_API std::string SnPTraceName(int row, int column);

/// Reads a trace name in either case ("S21", "s1_10") into `row` and `column`; false for text
/// that is not such a name. The indices are not checked against a port count; "S1_2" reads
/// as S12 would.
LUMEN_API bool SnPParseTraceName(std::string_view name, int& row, int& column);
