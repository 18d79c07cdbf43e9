/** @file */
/// @class FileMapping
/// FileMapping: owner of one named shared-memory object, the section other processes open by
/// name to read measurement data.
///
/// The object behind block name N is the POSIX shared-memory object "/N" (N in UTF-8). It is
/// created with mode 0600, so only the owner's processes may attach, or opened when it exists
/// already. The name is removed from the shared-memory namespace when the last FileMapping of
/// the creating process that holds it goes away; views already mapped, here or in other
/// processes, stay valid until they are unmapped.
///
/// Failures throw an HRESULT by value built from the errno value e of the failing call:
/// (e & 0xFFFF) | 0x80070000, for example 0x80070016 (EINVAL) for an invalid name and
/// 0x8007000D (EACCES) for an object of another user.
///
/// Thread-safety: each object belongs to one thread at a time; objects on different threads,
/// of the same name too, may be created and destroyed concurrently. Ownership: the object owns
/// its descriptor; a copy holds a descriptor of its own on the same memory.
#pragma once

#include <cstdint>
#include <string>

#include "lumen/export.h"

class LUMEN_API FileMapping {
 public:
  /// Creates the object `name` of `size` bytes (1 or more), or opens it when it exists. Throws
  /// 0x80070057 for size < 1, 0x80070016 for a name that is empty or holds "/" or a NUL
  /// character, 0x80070011 (EEXIST) when an existing object is smaller than `size`, and the
  /// errno-built code of any other failing call (0x8007001C, ENOSPC, when the memory for a new
  /// object cannot be reserved).
  FileMapping(const std::wstring& name, std::int64_t size);
  /// A second handle on the same object (a duplicated descriptor); throws the errno-built code
  /// when the descriptor cannot be duplicated.
  FileMapping(const FileMapping& other);
  /// Makes this a handle on `other`'s object; on a throw (as the copy constructor) this object
  /// is unchanged.
  FileMapping& operator=(const FileMapping& other);
  ~FileMapping();

  /// The descriptor of the shared-memory object.
  int GetHandle() const { return m_handle; }

 private:
  void Close() noexcept;

  int m_handle;
  std::string m_objectName;
  bool m_holdsName;  ///< this process created the name and this object counts as a holder
};
