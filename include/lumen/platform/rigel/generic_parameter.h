/** @file */
/// @class Rigel::GenericParameter
/// Rigel::GenericParameter: the hardware-interface library's abstract value of one named
/// acquisition parameter.
///
/// Every typed value (a scalar, an array or a reference into an array) derives from it and is
/// handed around as boost::shared_ptr<GenericParameter>. The base carries the name and a change
/// flag that the hardware layer reads to learn which parameters to send. The operations keep
/// this declaration order: it is the order of the virtual slots the hardware layer calls
/// through. The base implementations are the plain ones of a single value that is not a
/// container: no elements to index, find, insert or remove.
/// Thread-safety: confine each object to one thread. Ownership: values are shared through
/// boost::shared_ptr; a parameter owns its name only.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include <boost/shared_ptr.hpp>

#include "lumen/export.h"

namespace Rigel {

class LUMEN_API GenericParameter {
 public:
  /// How values are held and handed around.
  using Ptr = boost::shared_ptr<GenericParameter>;

  /// A parameter without a name.
  GenericParameter() = default;
  /// A parameter named `name`, change flag clear.
  explicit GenericParameter(std::wstring name) : m_name(std::move(name)) {}
  ///@{
  /// Copies the name and the change flag.
  GenericParameter(const GenericParameter&) = default;
  GenericParameter& operator=(const GenericParameter&) = default;
  ///@}

  /// The parameter's name, compared exactly (case-sensitive) wherever names are matched.
  const std::wstring& name() const { return m_name; }

  /// True once set_change_flag was called and clear_change_flag not since.
  virtual bool get_change_flag() const;
  /// Marks the value as changed, to be sent by the hardware layer.
  virtual void set_change_flag();
  /// Marks the value as sent.
  virtual void clear_change_flag();

  /// Releases the name.
  virtual ~GenericParameter();

  /// Element `index` as a new scalar value; the base has no elements: an empty pointer.
  virtual Ptr at(std::uint32_t index);
  /// A reference to element `index`; the base has no elements: an empty pointer.
  virtual Ptr referenced_at(std::uint32_t index);
  /// Stores `value` at `index`; the base ignores it.
  virtual void set_at(std::uint32_t index, const Ptr& value);
  ///@{
  /// Container operations of the hardware layer; the base is no container: each returns
  /// false, an empty pointer or -1 and changes nothing.
  virtual bool append(const Ptr& value);
  virtual bool insert(std::uint32_t index, const Ptr& value);
  virtual Ptr ptr_find(const std::wstring& name);
  virtual std::int32_t pos_find(const std::wstring& name);
  virtual Ptr ptr_quick_search(const std::wstring& name);
  virtual bool remove(std::uint32_t index);
  ///@}
  /// Number of values held; the base holds one.
  virtual std::uint32_t size() const;
  /// Number of values including those of nested parameters; the base: size().
  virtual std::uint32_t total_size() const;
  /// Sets the number of values; the base holds exactly one and ignores it.
  virtual void resize(std::uint32_t count);
  /// The name, a blank and value_to_string(brief).
  virtual std::wstring to_string(bool brief) const;
  /// The name of the value type; the base has none: an empty string.
  virtual std::wstring value_type_to_string() const;
  /// A new default object of the same class.
  virtual Ptr create_default() const = 0;
  /// A copy of this object.
  virtual Ptr clone() const = 0;
  /// The base knows no values to compare: true only for this very object.
  virtual bool IsEqual(const GenericParameter& other) const;
  /// True when `other` is not empty and of this object's class (or a class derived from it).
  virtual bool is_same_type(const Ptr& other) const = 0;
  /// Gathers the values of `list` into one array value; the base makes none (empty pointer).
  virtual Ptr FromVectorToGPPtr(std::vector<Ptr>& list);
  /// The value alone as text; `brief` leaves out the elements of a container.
  virtual std::wstring value_to_string(bool brief) const = 0;

 private:
  std::wstring m_name;
  bool m_changeFlag = false;
};

}  // namespace Rigel
