#pragma once

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "platform/ui/view_controller.h"
#include "platform/value.h"

namespace wp {

/// The inputs of a diagnostic: made by the extension, given the request's parameters by the host. *Main*.
class DiagnosticInputs {
  public:
    virtual ~DiagnosticInputs() = default;

    /// Takes over the parameters; false when one of them is not acceptable, and the host then rejects the
    /// request.
    virtual bool validateAndInitializeParameters(DictionaryPointer parameters) = 0;

    /// Why the last validation failed, as one line for the person who made the request; empty when it did
    /// not.
    virtual std::string failureReason() const = 0;
};

/// Where a diagnostic may report on its way. This system's diagnostic has nothing to report before its end.
class DiagnosticResponder {
  public:
    virtual ~DiagnosticResponder() = default;
};

/// What a finished diagnostic hands to the host: a status code and a data dictionary, taken together, once.
/// *Any* thread.
class DiagnosticResult {
  public:
    /// Sets both and seals the result. Returns false, and changes nothing, when it is sealed already: a run
    /// ends with the first code that it was given.
    bool seal(std::int64_t statusCode, DictionaryPointer data);

    /// Nothing before the result is sealed.
    std::optional<std::int64_t> statusCode() const;
    /// Null before the result is sealed. The dictionaries inside are live until the host has drained the
    /// queues.
    DictionaryPointer data() const;

  private:
    mutable std::mutex mutex_;
    std::optional<std::int64_t> statusCode_;
    DictionaryPointer data_;
};

/// The base of an extension's controller, which the host drives: set up, start, wait until finished, tear
/// down.
class DiagnosticViewController : public ui::ViewController {
  public:
    /// *Main*; once, after validation. The responder may be null.
    virtual void setupWithInputs(std::shared_ptr<DiagnosticInputs> inputs,
                                 DiagnosticResponder* responder) = 0;
    /// *Main*; once, after set-up.
    virtual void start() = 0;
    /// *Main*; at the very end, and once `start` has returned.
    virtual void teardown() = 0;

    DiagnosticResult& result() { return result_; }
    /// Whether the run is over. *Any* thread.
    bool isFinished() const { return finished_; }
    /// Tells the host that the run is over. *Any* thread; the host's handler is called on that thread, once.
    void setFinished();
    /// After the end of the run no key reaches the diagnostic any more. *Main*.
    bool acceptsInput() const override { return !isFinished(); }
    /// *Main*, before `start`.
    void setFinishedHandler(std::function<void()> handler) { finishedHandler_ = std::move(handler); }

  private:
    DiagnosticResult result_;
    std::atomic<bool> finished_ = false;
    std::function<void()> finishedHandler_;
};

}  // namespace wp
