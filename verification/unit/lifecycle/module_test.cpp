#include <dlfcn.h>
#include <gtest/gtest.h>

#include "verification/unit/fakes/fake_device.h"
#include "verification/unit/fakes/printing.h"
#include "verification/unit/places.h"

// The module as its host sees it: loaded, and known by its exported names and the host's interfaces alone.

namespace wp {
namespace {

class Module : public ::testing::Test {
  protected:
    Module()
        : handle_(dlopen((buildFolder() + "/wifi-profile-extension.so").c_str(), RTLD_NOW | RTLD_LOCAL)) {
        if (!handle_) ADD_FAILURE() << dlerror();
    }

    template <class T>
    T* symbol(const char* name) {
        void* found = handle_ ? dlsym(handle_, name) : nullptr;
        EXPECT_NE(found, nullptr) << name;
        return reinterpret_cast<T*>(found);
    }

    // Never closed: blocks and static objects may hold its code to the end.
    void* handle_;
};

TEST_F(Module, MakesTheDiagnosticForAPlatformThroughItsEntry) {
    fakes::FakeDevice device;
    ExtensionContext context{device.platform, {}};
    auto* entry = symbol<ExtensionEntry>(kExtensionEntryName);
    ASSERT_NE(entry, nullptr);

    EXPECT_EQ(entry(0, nullptr, &context), 0);

    EXPECT_NE(context.objects.inputs, nullptr);
    EXPECT_NE(context.objects.controller, nullptr);
    EXPECT_EQ(registeredExtensionVersion(), kExtensionInterfaceVersion);
    EXPECT_EQ(entry(0, nullptr, nullptr), 1);
}

TEST_F(Module, GoesThroughAWholeRun) {
    fakes::FakeDevice device;
    ExtensionContext context{device.platform, {}};
    ASSERT_EQ(symbol<ExtensionEntry>(kExtensionEntryName)(0, nullptr, &context), 0);
    DiagnosticViewController& controller = *context.objects.controller;
    auto statistics = std::make_shared<PingStatistics>();
    statistics->count = 4;
    device.service.setJoinedNetwork("Home");
    device.service.setOutcome(
        3, fakes::outcome(true, true, Dictionary::make({{"PingResult", std::move(statistics)}})));
    ASSERT_TRUE(context.objects.inputs->validateAndInitializeParameters(
        Dictionary::make({{"maxScanCacheAge", 60}, {"reprofileWithUI", false}, {"networkName", "Office"}})));

    controller.setupWithInputs(context.objects.inputs, nullptr);
    controller.start();
    device.queues.runAll();
    controller.teardown();

    EXPECT_EQ(controller.result().statusCode(), 0);
    EXPECT_EQ(device.service.requests().size(), 56U);
    DictionaryPointer current = *controller.result().data()->value("currentNetwork")->as<DictionaryPointer>();
    ASSERT_TRUE(current->value("pingLANResult"));
    DictionaryPointer ping = *current->value("pingLANResult")->as<DictionaryPointer>();
    EXPECT_EQ(ping->value("count"), Value(4));
}

TEST_F(Module, SaysWhyItRefusesARequest) {
    fakes::FakeDevice device;
    ExtensionContext context{device.platform, {}};
    ASSERT_EQ(symbol<ExtensionEntry>(kExtensionEntryName)(0, nullptr, &context), 0);

    EXPECT_FALSE(context.objects.inputs->validateAndInitializeParameters(Dictionary::make()));

    EXPECT_EQ(context.objects.inputs->failureReason(),
              "\"maxScanCacheAge\" is missing: it must be a number from 0 to 600");
}

TEST_F(Module, ExportsTheNameKeyAndTheNullMarkerFunctions) {
    DictionaryPointer dictionary = Dictionary::make({{"a", NullMarker()}});

    EXPECT_STREQ(symbol<const char>("kNetworkName"), "networkName");
    EXPECT_TRUE(symbol<Value(const std::optional<std::string>&)>("stringOrNull")(std::nullopt).isNull());
    EXPECT_EQ(symbol<Value(const std::optional<Value>&)>("numberOrNull")(Value(3)), Value(3));
    EXPECT_TRUE(symbol<Value(const DictionaryPointer&)>("dictionaryOrNull")(nullptr).isNull());
    EXPECT_EQ(symbol<Value(double)>("numberOrNullForDouble")(0.5), Value(0.5));
    symbol<void(const DictionaryPointer&)>("removeNullFromDictionary")(dictionary);
    EXPECT_EQ(dictionary->size(), 0U);
}

}  // namespace
}  // namespace wp
