#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "service/ip_address.h"
#include "service/maker.h"

namespace wp {

/// The search for routers on the local network; it is sent to 239.255.255.250, port 1900. Only a search: no
/// device is ever asked to call back.
std::string ssdpSearch();

/// Where the description is that an answer to the search names; nothing where the message is no such answer,
/// or names anything but plain HTTP. *Any* thread.
std::optional<std::string> locationFromSsdp(std::string_view message);

/// What a device's description says, as far as it is bounded, well-formed text. Entities that the document
/// declares itself are never looked up. *Any* thread.
struct DeviceDescription {
    RouterDescription router;
    std::string controlUrl;   ///< of the service that knows the outer address; empty where there is none
    std::string serviceType;  ///< of that service
    std::string urlBase;
};
DeviceDescription readDeviceDescription(std::string_view xml);

/// The body of the question for the outer address.
std::string externalAddressQuestion(std::string_view serviceType);
/// The address in its answer.
std::optional<IPAddress> addressFromSoap(std::string_view xml);

}  // namespace wp
