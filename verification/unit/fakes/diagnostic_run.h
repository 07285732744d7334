#pragma once

#include <memory>
#include <optional>
#include <string>

#include "lifecycle/wifi_profile_view_controller.h"
#include "verification/unit/fakes/fake_device.h"

namespace wp::fakes {

enum class NetworkList { hidden, shown };

/// The parameters of a request that passes validation.
inline DictionaryPointer request(NetworkList list = NetworkList::hidden,
                                 std::optional<std::string> networkName = std::nullopt) {
    DictionaryPointer parameters =
        Dictionary::make({{"maxScanCacheAge", 30u}, {"reprofileWithUI", list == NetworkList::shown}});
    if (networkName) parameters->setValue("networkName", *networkName);
    return parameters;
}

/// A controller that is set up with validated inputs.
inline std::shared_ptr<WiFiProfileViewController> controllerFor(Platform& platform,
                                                                DictionaryPointer parameters) {
    auto inputs = std::make_shared<WiFiProfileInputs>();
    inputs->validateAndInitializeParameters(std::move(parameters));
    auto controller = std::make_shared<WiFiProfileViewController>(platform);
    controller->setupWithInputs(std::move(inputs), nullptr);
    return controller;
}

/// One run of the diagnostic on a device of fakes.
struct DiagnosticRun {
    explicit DiagnosticRun(NetworkList list = NetworkList::hidden,
                           std::optional<std::string> networkName = std::nullopt)
        : controller(controllerFor(device.platform, request(list, std::move(networkName)))) {
        device.screen.setRootViewController(controller);
    }

    /// Starts the run and takes every step until nothing is left to do.
    void runToEnd() {
        controller->start();
        device.queues.runAll();
    }

    std::optional<std::int64_t> statusCode() { return controller->result().statusCode(); }

    /// A section of the result document; null before the end.
    DictionaryPointer section(std::string_view name) {
        DictionaryPointer document = controller->result().data();
        std::optional<Value> value = document ? document->value(name) : std::nullopt;
        const DictionaryPointer* found = value ? value->as<DictionaryPointer>() : nullptr;
        return found ? *found : nullptr;
    }

    FakeDevice device;
    std::shared_ptr<WiFiProfileViewController> controller;
};

}  // namespace wp::fakes
