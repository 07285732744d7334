#include "exchange/live.h"

#include <atomic>
#include <mutex>

#include "exchange/power_callbacks.h"
#include "exchange/request_list.h"
#include "exchange/service_connection.h"
#include "exchange/wifi_radio.h"

namespace wp {
namespace {

using Kind = WireRequest::Kind;

constexpr int kMalformed = 10;

WireRequest requestOf(Kind kind) {
    WireRequest request;
    request.kind = kind;
    return request;
}

Error notUnderstood(const Refused& refused) {
    return {kMalformed,
            std::string("wifi-profile-service gave an answer of another form: ") + refused.what()};
}

/// Reads the answer, or turns what came instead of it into the response's error.
template <class Response>
Response responseFrom(const ServiceConnection::Outcome& outcome, Response (*read)(const WireAnswer&)) {
    Response response;
    if (const auto* error = std::get_if<Error>(&outcome)) {
        response.error = *error;
        return response;
    }
    try {
        return read(std::get<WireAnswer>(outcome));
    } catch (const Refused& refused) {
        response.error = notUnderstood(refused);
        return response;
    }
}

class LiveDiagnosticsClient final : public DiagnosticsClient {
  public:
    LiveDiagnosticsClient(ServiceConnection& connection, const LiveServiceOptions& options)
        : connection_(connection), options_(options) {}

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override {
        return answerInTurn(requests, [this](const DiagnosticsTestRequest& test) {
            WireRequest request = requestOf(Kind::test);
            request.test = test.testID;
            request.configuration = test.configuration;
            return responseFrom(connection_.ask(std::move(request), options_.testDeadline), testAnswer);
        });
    }
    DiagnosticsStatusResponse queryStatus() override {
        return responseFrom(connection_.ask(requestOf(Kind::status), options_.queryDeadline), statusAnswer);
    }
    void cancelAllRequests() override { connection_.cancel(); }

  private:
    ServiceConnection& connection_;
    const LiveServiceOptions& options_;
};

/// The radio as the service last described it. Handles may outlive the service; then nothing changes any more.
class LiveRadio final : public WiFiRadio {
  public:
    using SendPower = std::function<void(bool)>;
    using Expectation = std::shared_ptr<void>;

    explicit LiveRadio(std::function<Expectation()> expectPowerChange)
        : expectPowerChange_(std::move(expectPowerChange)) {}

    std::vector<std::string> devices() override { return description().devices; }
    bool power() override { return description().power; }
    void setRunLoop(Queue& runLoop) override { runLoop_ = &runLoop; }
    void setCallback(const void* device, std::function<void()> callback) override {
        callbacks_->set(device, std::move(callback));
    }
    void setPower(bool power) override {
        SendPower sendPower;
        {
            std::lock_guard lock(mutex_);
            sendPower = sendPower_;
        }
        if (!sendPower) return;
        // Before the wish is sent: the change may come at once.
        if (power != this->power() && expectPowerChange_) expect(expectPowerChange_());
        sendPower(power);
    }
    /// Lets go of what was expected: what that wakes must not find the lock taken.
    void expect(Expectation expectation) {
        std::lock_guard lock(mutex_);
        expected_.swap(expectation);
    }

    WiFiDescription description() const {
        std::lock_guard lock(mutex_);
        return description_;
    }
    void setDescription(WiFiDescription description) {
        std::lock_guard lock(mutex_);
        description_ = std::move(description);
    }
    void setSender(SendPower sendPower) {
        std::lock_guard lock(mutex_);
        sendPower_ = std::move(sendPower);
    }
    void powerChanged(bool power) {
        {
            std::lock_guard lock(mutex_);
            description_.power = power;
        }
        if (Queue* runLoop = runLoop_) runLoop->async([callbacks = callbacks_] { callbacks->call(); });
        expect(nullptr);
    }

  private:
    mutable std::mutex mutex_;
    WiFiDescription description_{false, false, {}, false, {}};
    SendPower sendPower_;
    const std::function<Expectation()> expectPowerChange_;
    Expectation expected_;
    std::atomic<Queue*> runLoop_ = nullptr;
    std::shared_ptr<PowerCallbacks> callbacks_ = std::make_shared<PowerCallbacks>();
};

class LiveWiFiManagerService final : public WiFiManagerService {
  public:
    LiveWiFiManagerService(std::shared_ptr<ServiceConnection> connection, std::shared_ptr<LiveRadio> radio,
                           const LiveServiceOptions& options)
        : connection_(std::move(connection)), radio_(std::move(radio)), options_(options) {}

    bool hasRadio() override { return describe().radio; }

    std::shared_ptr<WiFiManagerClient> createClient(int) override {
        WiFiDescription description = describe();
        if (!description.radio || !description.client) return nullptr;
        return makeWiFiManagerClient(radio_);
    }

  private:
    /// Asks the service. The radio learns of the answer before any later event, so that the older news never
    /// covers the newer.
    WiFiDescription describe() {
        auto arrived = [radio = radio_](const WireAnswer& answer) {
            try {
                if (auto wifi = wifiAnswer(answer).wifi) radio->setDescription(*wifi);
            } catch (const Refused&) {  // whoever waits for the answer says so
            }
        };
        WiFiResponse response = responseFrom(
            connection_->ask(requestOf(Kind::wifi), options_.queryDeadline, arrived), wifiAnswer);
        if (response.error) note("the Wi-Fi radio cannot be asked for: " + response.error->text());
        return response.wifi.value_or(WiFiDescription{false, false, {}, false, {}});
    }

    void note(const std::string& text) const {
        if (options_.note) options_.note(text);
    }

    std::shared_ptr<ServiceConnection> connection_;
    std::shared_ptr<LiveRadio> radio_;
    const LiveServiceOptions& options_;
};

/// Sends a wish for power; what keeps it from being fulfilled becomes a note.
LiveRadio::SendPower powerSender(const std::shared_ptr<ServiceConnection>& connection,
                                 const std::shared_ptr<LiveRadio>& radio,
                                 const std::function<void(std::string_view)>& note) {
    return [weak = std::weak_ptr(connection), weakRadio = std::weak_ptr(radio), note](bool power) {
        auto alive = weak.lock();
        if (!alive) return;
        WireRequest request = requestOf(Kind::setPower);
        request.power = power;
        alive->tell(std::move(request), [weakRadio, note](const WireAnswer& answer) {
            std::optional<Error> error;
            try {
                error = setPowerAnswer(answer);
            } catch (const Refused& refused) {
                error = notUnderstood(refused);
            }
            if (error && note) note("Wi-Fi could not be switched: " + error->text());
            if (const auto live = error ? weakRadio.lock() : nullptr) live->expect(nullptr);
        });
    };
}

}  // namespace

class LiveService::Parts {
  public:
    Parts(ServiceProcess process, LiveServiceOptions given)
        : options(std::move(given)),
          radio(std::make_shared<LiveRadio>(options.expectPowerChange)),
          connection(std::make_shared<ServiceConnection>(
              std::move(process),
              ServiceConnection::Handlers{[live = radio](bool power) { live->powerChanged(power); },
                                          options.note})),
          diagnostics(*connection, options),
          wifi(connection, radio, options) {
        radio->setSender(powerSender(connection, radio, options.note));
    }
    ~Parts() {
        radio->setSender(nullptr);
        radio->expect(nullptr);
    }
    Parts(const Parts&) = delete;
    Parts& operator=(const Parts&) = delete;

    const LiveServiceOptions options;
    const std::shared_ptr<LiveRadio> radio;
    const std::shared_ptr<ServiceConnection> connection;
    LiveDiagnosticsClient diagnostics;
    LiveWiFiManagerService wifi;
};

LiveService::LiveService(ServiceProcess process, LiveServiceOptions options)
    : parts_(std::make_unique<Parts>(std::move(process), std::move(options))) {}

LiveService::~LiveService() = default;

DiagnosticsClient& LiveService::diagnostics() {
    return parts_->diagnostics;
}

WiFiManagerService& LiveService::wifi() {
    return parts_->wifi;
}

std::optional<Error> LiveService::failure() const {
    return parts_->connection->failure();
}

}  // namespace wp
