// A diagnostic whose start never returns: the host must be left all the same.
#include <unistd.h>

#include "platform/extension.h"

namespace {

class Inputs final : public wp::DiagnosticInputs {
  public:
    bool validateAndInitializeParameters(wp::DictionaryPointer) override { return true; }
    std::string failureReason() const override { return ""; }
};

class Controller final : public wp::DiagnosticViewController {
  public:
    explicit Controller(wp::Platform& platform) : log_(platform.log) {}
    void setupWithInputs(std::shared_ptr<wp::DiagnosticInputs>, wp::DiagnosticResponder*) override {}
    void start() override {
        log_.error(0, "hanging");
        for (;;) pause();
    }
    void teardown() override {}

  private:
    wp::Log& log_;
};

const wp::ExtensionRegistration kRegistration([](wp::Platform& platform) {
    return wp::ExtensionObjects{std::make_shared<Inputs>(), std::make_shared<Controller>(platform)};
});

}  // namespace

extern "C" WP_EXPORT int wifiProfileExtensionEntry(int argc, const char* const* argv,
                                                   wp::ExtensionContext* context) {
    return wp::extensionMain(argc, argv, context);
}
