#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <type_traits>
#include <utility>
#include <vector>

#include "platform/wifi_manager.h"

namespace wp::fakes {

/// A Wi-Fi manager service with a power switch. Its handles share one state and may outlive it. *Any* thread.
class FakeWiFiManager final : public WiFiManagerService {
  public:
    void setHasRadio(bool hasRadio) {
        with([&](State& state) { state.hasRadio = hasRadio; });
    }
    void setCreatesClients(bool creates) {
        with([&](State& state) { state.createsClients = creates; });
    }
    void setDeviceNames(std::vector<std::string> names) {
        with([&](State& state) { state.deviceNames = std::move(names); });
    }
    /// What `setPower` of a client does: turn the power (the default) or nothing.
    void setObeysSetPower(bool obeys) {
        with([&](State& state) { state.obeysSetPower = obeys; });
    }

    /// The state before a run, without a notification.
    void setInitialPower(int power) {
        with([&](State& state) { state.power = power; });
    }

    /// The switch: changes the power and notifies the registered device on its client's run loop.
    void turnPower(int power) { state_->turnPower(power); }

    int power() const {
        return with([](State& state) { return state.power; });
    }
    /// What the diagnostic asked for, in order ("type 0", "scheduled", "power 1" ...).
    std::vector<std::string> calls() const {
        return with([](State& state) { return state.calls; });
    }
    int clientsAlive() const {
        return with([](State& state) { return state.clientsAlive; });
    }
    int devicesAlive() const {
        return with([](State& state) { return state.devicesAlive; });
    }
    bool hasCallback() const {
        return with([](State& state) { return static_cast<bool>(state.callback); });
    }
    std::string callbackDevice() const {
        return with([](State& state) { return state.callbackDevice; });
    }
    Queue* runLoop() const {
        return with([](State& state) { return state.runLoop; });
    }

    bool hasRadio() override {
        return with([](State& state) { return state.hasRadio; });
    }

    std::shared_ptr<WiFiManagerClient> createClient(int type) override {
        bool creates = with([&](State& state) {
            state.calls.push_back("client of type " + std::to_string(type));
            return state.createsClients;
        });
        return creates ? std::make_shared<Client>(state_) : nullptr;
    }

  private:
    struct State : std::enable_shared_from_this<State> {
        void turnPower(int newPower) {
            Queue* target = nullptr;
            {
                std::lock_guard lock(mutex);
                power = newPower;
                target = callback ? runLoop : nullptr;
            }
            // Looks for the callback again when it is delivered: one that is unregistered meanwhile is not called.
            if (target) target->async([state = shared_from_this()] { state->deliver(); });
        }

        void deliver() {
            std::function<void()> registered;
            {
                std::lock_guard lock(mutex);
                registered = callback;
            }
            if (registered) registered();
        }

        std::mutex mutex;
        bool hasRadio = true;
        bool createsClients = true;
        bool obeysSetPower = true;
        int power = 1;
        std::vector<std::string> deviceNames = {"wlan0"};
        std::vector<std::string> calls;
        std::function<void()> callback;
        std::string callbackDevice;
        Queue* runLoop = nullptr;
        int clientsAlive = 0;
        int devicesAlive = 0;
    };
    using StatePointer = std::shared_ptr<State>;

    class Device final : public WiFiDeviceClient {
      public:
        Device(StatePointer state, std::string name) : state_(std::move(state)), name_(std::move(name)) {
            std::lock_guard lock(state_->mutex);
            ++state_->devicesAlive;
        }
        ~Device() override {
            std::lock_guard lock(state_->mutex);
            --state_->devicesAlive;
        }
        std::string interfaceName() const override { return name_; }
        void registerPowerCallback(std::function<void()> callback) override {
            std::lock_guard lock(state_->mutex);
            state_->calls.push_back(callback ? "registered" : "unregistered");
            state_->callback = std::move(callback);
            state_->callbackDevice = name_;
        }

      private:
        StatePointer state_;
        std::string name_;
    };

    class Client final : public WiFiManagerClient {
      public:
        explicit Client(StatePointer state) : state_(std::move(state)) {
            std::lock_guard lock(state_->mutex);
            ++state_->clientsAlive;
        }
        ~Client() override {
            std::lock_guard lock(state_->mutex);
            state_->calls.push_back("client released");
            --state_->clientsAlive;
        }
        void scheduleWithRunLoop(Queue& runLoop) override {
            std::lock_guard lock(state_->mutex);
            state_->calls.push_back("scheduled");
            state_->runLoop = &runLoop;
        }
        void setType(int type) override {
            std::lock_guard lock(state_->mutex);
            state_->calls.push_back("type " + std::to_string(type));
        }
        std::vector<std::shared_ptr<WiFiDeviceClient>> copyDevices() override {
            std::vector<std::string> names;
            {
                std::lock_guard lock(state_->mutex);
                state_->calls.push_back("devices copied");
                names = state_->deviceNames;
            }
            std::vector<std::shared_ptr<WiFiDeviceClient>> devices;
            for (const std::string& name : names) devices.push_back(std::make_shared<Device>(state_, name));
            return devices;
        }
        int power() override {
            std::lock_guard lock(state_->mutex);
            return state_->power;
        }
        void setPower(int power) override {
            bool obeys = false;
            {
                std::lock_guard lock(state_->mutex);
                state_->calls.push_back("power " + std::to_string(power));
                obeys = state_->obeysSetPower;
            }
            if (obeys) state_->turnPower(power);
        }

      private:
        StatePointer state_;
    };

    template <class Function>
    std::invoke_result_t<Function, State&> with(Function function) const {
        std::lock_guard lock(state_->mutex);
        return function(*state_);
    }

    StatePointer state_ = std::make_shared<State>();
};

}  // namespace wp::fakes
