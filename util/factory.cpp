#include "lumen/util/factory.h"

#include <boost/function/function_base.hpp>

namespace LumenUtility {

boost::shared_ptr<IFactory> CreateFactory() {
  // Never destroyed: creators may hold on to objects of modules whose static destructors
  // run before ours, and destroying the map at exit would run theirs in the wrong order.
  static const boost::shared_ptr<IFactory>* const factory =
      new boost::shared_ptr<IFactory>(new Factory);
  return *factory;
}

}  // namespace LumenUtility

boost::any Factory::Create(const std::wstring& key) {
  // operator[] on purpose: a key asked for before anyone registered it keeps an empty entry.
  const LumenUtility::FactoryCreator& entry = m_creators[key];
  if (entry.empty()) throw boost::bad_function_call();
  // Run a copy: a creator may register or unregister its own key while it runs.
  const LumenUtility::FactoryCreator creator = entry;
  return creator();
}

void Factory::Register(const std::wstring& key, const LumenUtility::FactoryCreator& creator) {
  m_creators[key] = creator;
}

void Factory::Unregister(const std::wstring& key) {
  m_creators.erase(key);
}
