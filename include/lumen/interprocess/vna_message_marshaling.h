/** @file */
/// @class vna_interprocess::VNAMessageMarshaling
/// VNAMessageMarshaling: the cursor over an interprocess message block. Storing, it appends raw
/// bytes, length-prefixed strings and whole messages to the caller's byte vector; loading, it
/// reads them back in the same order and rebuilds messages of the right class through the type
/// registry (sm_vector by the index on the wire, sm_table by run-time type name).
///
/// The block is the items back to back, little-endian, without header or padding: a string is
/// its 4-byte length and its bytes; an object its 4-byte type index (0 VNAMessageEvent, 1
/// VNAMessageError, 2 VNAMessageText) and then what its marshal writes. Reading never throws on
/// short or bad data: a read that does not fit leaves its target untouched (a string empty, an
/// object pointer empty) and, unless stated, the cursor in place.
/// Thread-safety: confine each object to one thread. The registry is filled once, on the first
/// construction in the process, safely even when threads construct at the same moment.
/// Ownership: the byte vector is the caller's and must outlive the object; copies work on the
/// same vector.
#pragma once

#include <boost/shared_ptr.hpp>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

#include "lumen/export.h"
#include "lumen/interprocess/vna_marshal_object.h"

namespace vna_interprocess {

class LUMEN_API VNAMessageMarshaling {
 public:
  /// Fixed to int so that every value a caller passes is a valid one (all but 0 read).
  enum OPERATION : int { STORE = 0, LOAD = 1 };

  /// One registered message class.
  struct FACTORY_ENTRY {
    /// The type index on the wire; -1 ends the static table.
    int index;
    /// The class's run-time type name.
    std::string (*getName)();
    /// A new object of the class, its fields read from the loading marshaling object.
    VNAMarshalObject* (*create)(VNAMessageMarshaling& m);
  };

  /// `op` STORE writes and empties `buffer` first; any other value reads it from the start.
  VNAMessageMarshaling(OPERATION op, std::vector<unsigned char>& buffer);
  /// Works on the same vector from the same cursor.
  VNAMessageMarshaling(const VNAMessageMarshaling& other) = default;
  VNAMessageMarshaling& operator=(const VNAMessageMarshaling&) = delete;
  virtual ~VNAMessageMarshaling() = default;

  /// True for a cursor that writes, false for one that reads.
  bool IsStoring() const { return m_storing; }
  /// The byte offset of the next read or write.
  std::uint32_t GetPosition() const { return m_position; }

  /// Sets the vector's size to the cursor plus `n` (dropping anything beyond), copies the `n`
  /// bytes at `data` (which must not point into the vector) to the cursor and moves past them;
  /// n = 0 does nothing. Throws std::length_error, writing
  /// nothing, when the block would pass 4 GiB - 1 (the reach of the 32-bit cursor).
  void WriteToBuffer(const unsigned char* data, unsigned int n);
  /// Writes the 4-byte length, then the bytes; std::length_error as above.
  void WriteToBuffer(const std::string& s);
  /// Writes the type index of the object's class and then the object's fields; an object of
  /// an unregistered class, or null, writes nothing.
  void WriteToBuffer(const VNAMarshalObject* obj);

  /// Copies the next `n` bytes to `data` and moves past them when n > 0 and that many remain;
  /// otherwise copies nothing.
  void ReadFromBuffer(unsigned char* data, unsigned int n);
  /// Empties `s`, then reads a 4-byte length and that many bytes into `s`. When fewer than 4
  /// bytes remain, or the length exceeds the bytes after it, `s` stays empty and nothing is
  /// consumed.
  void ReadFromBuffer(std::string& s);
  /// Empties `p`, then reads a 4-byte type index and rebuilds an object of that class from
  /// the fields that follow. An index outside the registry consumes its 4 bytes and leaves `p`
  /// empty; fewer than 4 bytes consume nothing. Throws std::bad_alloc when memory runs out.
  void ReadFromBuffer(boost::shared_ptr<VNAMarshalObject>& p);

  ///@{
  /// The registry: entries by type index, and by run-time type name.
  static std::vector<FACTORY_ENTRY*> sm_vector;
  static std::unordered_map<std::string, FACTORY_ENTRY*> sm_table;
  ///@}

 private:
  /// The index registered for the class `name`, or -1.
  static int GetIndexForName(const std::string& name);
  /// Fills the registry from sm_entries, once per process.
  static void FillRegistry();
  std::size_t Remaining() const;
  /// Throws std::length_error when `n` more bytes would carry the block past the cursor's reach.
  void CheckRoomFor(std::uint64_t n) const;

  /// The registered classes, ended by an entry with index -1.
  static FACTORY_ENTRY sm_entries[];

  bool m_storing;
  std::vector<unsigned char>& m_buffer;
  std::uint32_t m_position = 0;
};

}  // namespace vna_interprocess
