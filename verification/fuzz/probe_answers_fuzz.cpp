#include <cstdlib>

#include "linux/probe/name_lookup.h"
#include "linux/probe/port_mapping.h"
#include "linux/probe/stun_message.h"

using namespace wp;

/// What servers and routers answer to the small requests, name servers too; transaction and nonce are those of the corpus.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    constexpr StunTransaction kOwn = {0xB7, 0xE7, 0xA7, 0x01, 0xBC, 0x34, 0xD6, 0x86, 0xFA, 0x87, 0xDF, 0xAE};
    const Bytes message(data, size);
    const auto mapped = addressFromStun(message, kOwn);
    const auto external = readExternalAddress(message);
    const auto younger = addressFromPcp(message, kOwn);
    for (const auto& address : {mapped, external ? external->external : std::nullopt, younger})
        if (address && IPAddress::fromText(address->text()) != address) std::abort();
    for (const RecordType type : {RecordType::a, RecordType::aaaa})
        for (const IPAddress& address : addressesFromAnswer(type, message))
            if (IPAddress::fromText(address.text()) != address) std::abort();
    return 0;
}
