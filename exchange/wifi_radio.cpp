#include "exchange/wifi_radio.h"

namespace wp {
namespace {

class Device final : public WiFiDeviceClient {
  public:
    Device(std::shared_ptr<WiFiRadio> radio, std::string name)
        : radio_(std::move(radio)), name_(std::move(name)) {}
    ~Device() override { radio_->setCallback(this, nullptr); }
    Device(const Device&) = delete;
    Device& operator=(const Device&) = delete;

    std::string interfaceName() const override { return name_; }
    void registerPowerCallback(std::function<void()> callback) override {
        radio_->setCallback(this, std::move(callback));
    }

  private:
    std::shared_ptr<WiFiRadio> radio_;
    std::string name_;
};

class Client final : public WiFiManagerClient {
  public:
    explicit Client(std::shared_ptr<WiFiRadio> radio) : radio_(std::move(radio)) {}

    void scheduleWithRunLoop(Queue& runLoop) override { radio_->setRunLoop(runLoop); }
    void setType(int) override {}
    std::vector<std::shared_ptr<WiFiDeviceClient>> copyDevices() override {
        std::vector<std::shared_ptr<WiFiDeviceClient>> devices;
        for (std::string& name : radio_->devices())
            devices.push_back(std::make_shared<Device>(radio_, std::move(name)));
        return devices;
    }
    int power() override { return radio_->power() ? 1 : 0; }
    void setPower(int power) override { radio_->setPower(power != 0); }

  private:
    std::shared_ptr<WiFiRadio> radio_;
};

}  // namespace

std::shared_ptr<WiFiManagerClient> makeWiFiManagerClient(std::shared_ptr<WiFiRadio> radio) {
    return std::make_shared<Client>(std::move(radio));
}

}  // namespace wp
