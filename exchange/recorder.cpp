#include "exchange/recorder.h"

#include <algorithm>
#include <mutex>
#include <set>

#include "exchange/answer_book.h"
#include "exchange/fresh_copy.h"
#include "exchange/request_list.h"

namespace wp {
namespace {

using Clock = std::chrono::steady_clock;
using std::chrono::milliseconds;

milliseconds since(Clock::time_point begin) {
    return std::chrono::floor<milliseconds>(Clock::now() - begin);
}

/// The configuration's age, where it is a number.
std::optional<Value> ageOfRequest(const DictionaryPointer& configuration) {
    std::optional<Value> age = configuration ? configuration->value("MaxScanCacheAge") : std::nullopt;
    bool isNumber = age && (age->as<std::int64_t>() || age->as<std::uint64_t>() || age->as<double>());
    return isNumber ? age : std::nullopt;
}

bool isSame(const DiagnosticsStatusResponse& left, const DiagnosticsStatusResponse& right) {
    return encodeStatus(left) == encodeStatus(right);
}

/// Leaves the ages out where they tell no requests apart.
void dropNeedlessAges(std::vector<RecordedAnswer>& answers) {
    std::map<std::pair<int, std::optional<std::string>>, std::vector<std::optional<Value>>> ages;
    for (const RecordedAnswer& answer : answers) {
        auto& known = ages[{answer.test, answer.networkName}];
        if (std::find(known.begin(), known.end(), answer.maxScanCacheAge) == known.end())
            known.push_back(answer.maxScanCacheAge);
    }
    for (RecordedAnswer& answer : answers)
        if (ages[{answer.test, answer.networkName}].size() == 1) answer.maxScanCacheAge.reset();
    // An entry without an age also serves requests with one: it must not stand before their own.
    std::stable_partition(answers.begin(), answers.end(),
                          [](const RecordedAnswer& answer) { return answer.maxScanCacheAge.has_value(); });
}

}  // namespace

/// What was heard so far.
class Recorder::Tape {
  public:
    /// A request begins; its answer is to be handed in under this number.
    std::size_t beginTest(const DiagnosticsTestRequest& request) {
        std::lock_guard lock(mutex_);
        Slot& slot = tests_.emplace_back();
        slot.answer.test = request.testID;
        slot.answer.networkName = networkOfRequest(request.testID, request.configuration);
        slot.answer.maxScanCacheAge = ageOfRequest(request.configuration);
        return tests_.size() - 1;
    }
    void endTest(std::size_t number, DiagnosticsTestResponse response) {
        std::lock_guard lock(mutex_);
        Slot& slot = tests_[number];
        slot.answer.response = std::move(response);
        slot.answer.delay = since(slot.begin);
        slot.isAnswered = true;
    }

    std::size_t beginStatus() {
        std::lock_guard lock(mutex_);
        status_.emplace_back();
        return status_.size() - 1;
    }
    void endStatus(std::size_t number, DiagnosticsStatusResponse response) {
        std::lock_guard lock(mutex_);
        status_[number] = std::move(response);
    }

    void noteRadio(bool hasRadio) {
        std::lock_guard lock(mutex_);
        recording_.wifi.radio = hasRadio;
    }
    void noteClient(bool isMade) {
        std::lock_guard lock(mutex_);
        if (recording_.wifi.radio) recording_.wifi.client = isMade;
    }
    void noteDevices(std::vector<std::string> names) {
        std::lock_guard lock(mutex_);
        recording_.wifi.devices = std::move(names);
    }
    void notePower(bool power) {
        std::lock_guard lock(mutex_);
        if (!power_) recording_.wifi.power = power;
        power_ = power;
    }
    void noteWish(bool power) {
        std::lock_guard lock(mutex_);
        if (power_ != power) wish_ = power;
    }
    void noteRegistration() {
        std::lock_guard lock(mutex_);
        if (!registered_) registered_ = Clock::now();
    }
    void notePowerChange(bool power) {
        std::lock_guard lock(mutex_);
        power_ = power;
        bool isWish = wish_ == power;
        if (isWish) wish_.reset();
        if (!isWish && registered_) recording_.events.push_back({since(*registered_), power});
    }

    void noteCapability(std::string_view name, bool answer) {
        std::lock_guard lock(mutex_);
        recording_.capabilities.insert_or_assign(std::string(name), answer);
    }
    void setDescription(std::string description) {
        std::lock_guard lock(mutex_);
        recording_.description = std::move(description);
    }
    void setAutomation(bool isEnabled) {
        std::lock_guard lock(mutex_);
        recording_.automation = isEnabled;
    }

    Recording recording() const {
        std::lock_guard lock(mutex_);
        Recording recording = recording_;
        if (wish_ && power_ != wish_) recording.wifi.setPower = WiFiDescription::SetPower::ignored;
        for (const Slot& slot : tests_)
            if (slot.isAnswered) recording.answers.push_back(slot.answer);
        dropNeedlessAges(recording.answers);
        for (const auto& status : status_)
            if (status) recording.status.push_back(*status);
        auto& list = recording.status;  // the last entry serves all later queries
        while (list.size() >= 2 && isSame(list.back(), list[list.size() - 2])) list.pop_back();
        return recording;
    }

  private:
    struct Slot {
        RecordedAnswer answer;
        Clock::time_point begin = Clock::now();
        bool isAnswered = false;
    };

    mutable std::mutex mutex_;
    Recording recording_;
    std::vector<Slot> tests_;
    std::vector<std::optional<DiagnosticsStatusResponse>> status_;
    std::optional<bool> power_;
    std::optional<bool> wish_;
    std::optional<Clock::time_point> registered_;
};

class Recorder::Diagnostics final : public DiagnosticsClient {
  public:
    Diagnostics(DiagnosticsClient& service, std::shared_ptr<Tape> tape)
        : service_(service), tape_(std::move(tape)) {}

    DiagnosticsTestResponse runTestRequests(const std::vector<DiagnosticsTestRequest>& requests) override {
        return answerInTurn(requests, [this](const DiagnosticsTestRequest& request) {
            std::size_t number = tape_->beginTest(request);
            DiagnosticsTestResponse response = service_.runTestRequests({request});
            tape_->endTest(number, freshCopy(response));
            return response;
        });
    }
    DiagnosticsStatusResponse queryStatus() override {
        std::size_t number = tape_->beginStatus();
        DiagnosticsStatusResponse response = service_.queryStatus();
        tape_->endStatus(number, response);
        return response;
    }
    void cancelAllRequests() override { service_.cancelAllRequests(); }

  private:
    DiagnosticsClient& service_;
    std::shared_ptr<Tape> tape_;
};

class Recorder::Device final : public WiFiDeviceClient {
  public:
    Device(std::shared_ptr<WiFiDeviceClient> device, std::weak_ptr<WiFiManagerClient> client,
           std::shared_ptr<Tape> tape)
        : device_(std::move(device)), client_(std::move(client)), tape_(std::move(tape)) {}

    std::string interfaceName() const override { return device_->interfaceName(); }
    void registerPowerCallback(std::function<void()> callback) override {
        if (!callback) return device_->registerPowerCallback(nullptr);
        tape_->noteRegistration();
        device_->registerPowerCallback([tape = tape_, client = client_, callback = std::move(callback)] {
            if (auto alive = client.lock()) tape->notePowerChange(alive->power() != 0);
            callback();
        });
    }

  private:
    std::shared_ptr<WiFiDeviceClient> device_;
    std::weak_ptr<WiFiManagerClient> client_;
    std::shared_ptr<Tape> tape_;
};

class Recorder::Client final : public WiFiManagerClient {
  public:
    Client(std::shared_ptr<WiFiManagerClient> client, std::shared_ptr<Tape> tape)
        : client_(std::move(client)), tape_(std::move(tape)) {}

    void scheduleWithRunLoop(Queue& runLoop) override { client_->scheduleWithRunLoop(runLoop); }
    void setType(int type) override { client_->setType(type); }
    std::vector<std::shared_ptr<WiFiDeviceClient>> copyDevices() override {
        std::vector<std::shared_ptr<WiFiDeviceClient>> devices = client_->copyDevices();
        std::vector<std::string> names;
        for (auto& device : devices) {
            names.push_back(device->interfaceName());
            device = std::make_shared<Device>(std::move(device), client_, tape_);
        }
        tape_->noteDevices(std::move(names));
        return devices;
    }
    int power() override {
        int power = client_->power();
        tape_->notePower(power != 0);
        return power;
    }
    void setPower(int power) override {
        tape_->noteWish(power != 0);
        client_->setPower(power);
    }

  private:
    std::shared_ptr<WiFiManagerClient> client_;
    std::shared_ptr<Tape> tape_;
};

class Recorder::WiFi final : public WiFiManagerService {
  public:
    WiFi(WiFiManagerService& service, std::shared_ptr<Tape> tape)
        : service_(service), tape_(std::move(tape)) {}

    bool hasRadio() override {
        bool hasRadio = service_.hasRadio();
        tape_->noteRadio(hasRadio);
        return hasRadio;
    }
    std::shared_ptr<WiFiManagerClient> createClient(int type) override {
        std::shared_ptr<WiFiManagerClient> client = service_.createClient(type);
        tape_->noteClient(client != nullptr);
        return client ? std::make_shared<Client>(std::move(client), tape_) : nullptr;
    }

  private:
    WiFiManagerService& service_;
    std::shared_ptr<Tape> tape_;
};

class Recorder::Capabilities final : public CapabilityQuery {
  public:
    Capabilities(const CapabilityQuery& query, std::shared_ptr<Tape> tape)
        : query_(query), tape_(std::move(tape)) {}

    bool booleanAnswer(std::string_view capability) const override {
        bool answer = query_.booleanAnswer(capability);
        tape_->noteCapability(capability, answer);
        return answer;
    }

  private:
    const CapabilityQuery& query_;
    std::shared_ptr<Tape> tape_;
};

Recorder::Recorder(DiagnosticsClient& diagnostics, WiFiManagerService& wifi,
                   const CapabilityQuery& capabilities)
    : tape_(std::make_shared<Tape>()),
      diagnostics_(std::make_unique<Diagnostics>(diagnostics, tape_)),
      wifi_(std::make_unique<WiFi>(wifi, tape_)),
      capabilities_(std::make_unique<Capabilities>(capabilities, tape_)) {}

Recorder::~Recorder() = default;

DiagnosticsClient& Recorder::diagnostics() {
    return *diagnostics_;
}

WiFiManagerService& Recorder::wifi() {
    return *wifi_;
}

CapabilityQuery& Recorder::capabilities() {
    return *capabilities_;
}

void Recorder::setDescription(std::string description) {
    tape_->setDescription(std::move(description));
}

void Recorder::setAutomation(bool isEnabled) {
    tape_->setAutomation(isEnabled);
}

Recording Recorder::recording() const {
    return tape_->recording();
}

}  // namespace wp
