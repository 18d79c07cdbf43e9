#include "globalstate/channel_manager_link.h"

#include <boost/any.hpp>
#include <boost/function/function_base.hpp>

#include "globalstate/global_state_names.h"
#include "lumen/util/factory.h"
#include "lumen/util/host_interfaces.h"

namespace LumenUtility {

ChannelManagerLink& ChannelManagerLink::Instance() {
  static ChannelManagerLink link;
  return link;
}

IChannelManager* ChannelManagerLink::Get() {
  if (!m_manager) {
    try {
      const boost::any product = CreateFactory()->Create(GlobalStateNames::kChannelsManager);
      if (const auto* manager = boost::any_cast<boost::shared_ptr<IChannelManager>>(&product)) {
        m_manager = *manager;
      }
    } catch (const boost::bad_function_call&) {
      // No creator registered (yet): there is no channel manager.
    }
  }
  return m_manager.get();
}

}  // namespace LumenUtility
