/// @file
/// The capabilities table: how the library finds objects of the host application.
///
/// The host registers each of its service objects under two integer keys (a category and an
/// index within it) and a third key, the index of the object's interface type in the type
/// list; the stored value is the object's address, 0 meaning that nothing is registered. The
/// library reads the address back by the same three keys. Values are pointer-sized so that a
/// 64-bit build keeps whole addresses.
///
/// The table and the type list are process-wide and live until the process ends. Most code
/// uses the typed helpers of "lumen/util/host_object.h" instead of this interface.
///
/// Thread-safety: none; the table is not locked. Callers serialise all access (in practice the
/// host registers its objects during start-up on one thread).
#pragma once

#include <cstdint>
#include <typeinfo>
#include <vector>

#include "lumen/export.h"

namespace LumenUtility {

/// The six operations keep this declaration order: it is the order of the virtual slots that
/// hosts call through.
class LUMEN_API ICapabilitiesAccessor {
 public:
  /// Returns the position of type.name() in the type list, appending it on first use.
  /// Positions start at 0 and never change.
  virtual int RegisterType(const std::type_info& type) = 0;

  /// Stores value at [i][j][k], growing every level as needed (new entries 0).
  /// Throws std::invalid_argument when an index is negative, std::bad_alloc when growing fails.
  virtual void SetCapability(int i, int j, int k, std::intptr_t value) = 0;

  /// Returns the value at [i][j][k], or 0 when the entry does not exist or an index is
  /// negative. Grows the outer level to i + 1 entries, and table[i][j] to k + 1 entries when
  /// table[i][j] exists; table[i] itself never grows here.
  virtual std::intptr_t GetCapability(int i, int j, int k) = 0;

  /// Zeroes every entry [i][j][k] (any j) equal to value. Returns the number of j entries
  /// under i, or 0 with nothing changed when i does not exist.
  virtual int RemoveCapabilityValue(int i, int k, std::intptr_t value) = 0;

  /// Zeroes the entry [i][j][k] and returns k; when the entry does not exist nothing changes
  /// and the result is 0.
  virtual int ClearCapability(int i, int j, int k) = 0;

  /// Returns, ascending, every j whose entry [i][j][k] exists and is non-zero. Grows the
  /// outer level to i + 1 entries (nothing for a negative i).
  virtual std::vector<int> FindCapabilities(int i, int k) = 0;

 protected:
  /// Declared after the operations so that it takes the last slots. Callers never delete
  /// the accessor.
  virtual ~ICapabilitiesAccessor() = default;
};

/// Returns the one process-wide accessor, created on the first call; every call returns the
/// same address. The caller must not delete it.
LUMEN_API ICapabilitiesAccessor* CreateCapabilitiesAccessor();

}  // namespace LumenUtility

/// The library's accessor. It holds no data: every instance works on the process-wide table
/// and type list.
class LUMEN_API CapabilitiesAccessor : public LumenUtility::ICapabilitiesAccessor {
 public:
  CapabilitiesAccessor() = default;
  ~CapabilitiesAccessor() override = default;

  int RegisterType(const std::type_info& type) override;
  void SetCapability(int i, int j, int k, std::intptr_t value) override;
  std::intptr_t GetCapability(int i, int j, int k) override;
  int RemoveCapabilityValue(int i, int k, std::intptr_t value) override;
  int ClearCapability(int i, int j, int k) override;
  std::vector<int> FindCapabilities(int i, int k) override;
};
