#pragma once

#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "platform/capabilities.h"
#include "platform/localization.h"
#include "platform/test_automation.h"

namespace wp::fakes {

/// A device with the capabilities that the test gives it.
class FakeCapabilities final : public CapabilityQuery {
  public:
    void add(std::string capability) { capabilities_.insert(std::move(capability)); }
    bool booleanAnswer(std::string_view capability) const override {
        return capabilities_.contains(capability);
    }

  private:
    std::set<std::string, std::less<>> capabilities_;
};

/// Test automation that keeps what is posted to it.
class FakeTestAutomation final : public TestAutomation {
  public:
    void setEnabled(bool enabled) { enabled_ = enabled; }
    const std::vector<DictionaryPointer>& posted() const { return posted_; }

    bool isEnabled() const override { return enabled_; }
    void postConfiguration(DictionaryPointer configuration) override {
        posted_.push_back(std::move(configuration));
    }

  private:
    bool enabled_ = false;
    std::vector<DictionaryPointer> posted_;
};

/// A string table in which every key's text is "text of KEY", unless the test sets another. Names are sorted
/// with the letter case of A to Z ignored.
class FakeLocalization final : public Localization {
  public:
    void setText(std::string key, std::string text) { texts_[std::move(key)] = std::move(text); }

    std::string localizedString(std::string_view key) const override {
        auto found = texts_.find(key);
        return found == texts_.end() ? "text of " + std::string(key) : found->second;
    }

    std::string collationKey(std::string_view name) const override {
        std::string key(name);
        for (char& letter : key) {
            if (letter >= 'A' && letter <= 'Z') letter = static_cast<char>(letter - 'A' + 'a');
        }
        return key;
    }

  private:
    std::map<std::string, std::string, std::less<>> texts_;
};

}  // namespace wp::fakes
