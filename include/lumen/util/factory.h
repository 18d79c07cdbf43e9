/// @file
/// The object factory: creator functions registered under text keys.
///
/// A component registers a creator under a key (for example "CHANNELS_MANAGER"); another one
/// asks the factory to run it and receives the product as a boost::any, without either
/// linking against the other. Keys compare case-sensitively, by ordinary string order.
///
/// The factory is process-wide and lives until the process ends. Thread-safety: none; callers
/// serialise all access.
#pragma once

#include <map>
#include <string>

#include <boost/any.hpp>
#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "lumen/export.h"

namespace LumenUtility {

/// Makes one new object of a registered kind, wrapped in boost::any.
using FactoryCreator = boost::function<boost::any()>;

/// The three operations keep this declaration order: it is the order of the virtual slots.
class LUMEN_API IFactory {
 public:
  /// Runs the creator registered under key and returns its product. A key without a creator
  /// throws boost::bad_function_call ("call to empty boost::function") and leaves an empty
  /// entry for the key behind, which a later Register fills. Exceptions of the creator pass
  /// through unchanged.
  virtual boost::any Create(const std::wstring& key) = 0;

  /// Stores a copy of creator under key, replacing any earlier one.
  virtual void Register(const std::wstring& key, const FactoryCreator& creator) = 0;

  /// Removes key and its creator; an absent key is ignored.
  virtual void Unregister(const std::wstring& key) = 0;

  virtual ~IFactory() = default;
};

/// Returns a copy of the one process-wide factory pointer, created on the first call.
LUMEN_API boost::shared_ptr<IFactory> CreateFactory();

}  // namespace LumenUtility

/// The library's factory. Instances other than the process-wide one are independent.
class LUMEN_API Factory : public LumenUtility::IFactory {
 public:
  boost::any Create(const std::wstring& key) override;
  void Register(const std::wstring& key, const LumenUtility::FactoryCreator& creator) override;
  void Unregister(const std::wstring& key) override;

 private:
  std::map<std::wstring, LumenUtility::FactoryCreator> m_creators;
};
