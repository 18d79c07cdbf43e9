// ChannelManagerLink: reaches the host's channel manager, which the factory creates under
// "CHANNELS_MANAGER" (its product a boost::shared_ptr<IChannelManager>).
//
// The manager is created on the first call that finds a creator for it, then kept: later
// changes to the factory do not replace it. Until then each call asks the factory again, so
// a host that registers its creator after the first global state call is still found.
// Thread-safety: none. Ownership: the link shares ownership of the manager.
#pragma once

#include <boost/shared_ptr.hpp>

class IChannelManager;

namespace LumenUtility {

class ChannelManagerLink {
 public:
  // The process-wide link.
  static ChannelManagerLink& Instance();

  // The manager, or null while the factory has no creator for it or its product is no
  // boost::shared_ptr<IChannelManager> (or an empty one). Other exceptions of the creator pass
  // through.
  IChannelManager* Get();

 private:
  boost::shared_ptr<IChannelManager> m_manager;
};

}  // namespace LumenUtility
