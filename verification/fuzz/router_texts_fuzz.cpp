#include <cstdlib>

#include "linux/probe/ssdp.h"
#include "linux/probe/web_place.h"
#include "linux/probe/xml_text.h"

using namespace wp;

/// What a router says when it is searched for and described. What is taken over must be fit for a request.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    const auto location = locationFromSsdp(text);
    if (location && location->find_first_of("\r\n \t") != std::string::npos) std::abort();
    const DeviceDescription description = readDeviceDescription(text);
    if (description.serviceType.find_first_of("\r\n\"<") != std::string::npos) std::abort();
    const std::string control = resolveReference("http://192.168.1.1/d.xml", description.controlUrl);
    if (control.find_first_of("\r\n \t") != std::string::npos) std::abort();
    addressFromSoap(text);
    return 0;
}
