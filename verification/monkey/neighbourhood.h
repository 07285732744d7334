#pragma once

#include <optional>
#include <random>
#include <string>
#include <vector>

#include "verification/unit/network_list/list_run.h"

namespace wp::monkey {

/// The monkey's dice: the same seed throws the same numbers on every machine.
class Dice {
  public:
    explicit Dice(std::uint64_t seed) : engine_(seed) {}

    /// 0 to count - 1.
    int below(int count) { return static_cast<int>(engine_() % static_cast<std::uint64_t>(count)); }
    bool percent(int chance) { return below(100) < chance; }
    template <class T>
    const T& oneOf(const std::vector<T>& values) {
        return values[below(static_cast<int>(values.size()))];
    }

  private:
    std::mt19937_64 engine_;
};

/// How wild a life is. In a calm one nothing happens that may make the table repair itself.
enum class Temper { calm, wild };

/// What the air holds and the service says; changes while the monkey plays.
class Neighbourhood {
  public:
    Neighbourhood(Dice& dice, Temper temper);

    /// Sets what the next scan and status query answer.
    void change(Dice& dice, fakes::FakeDiagnosticsClient& service);

    std::string name(Dice& dice) const;

  private:
    fakes::AccessPoint accessPoint(Dice& dice) const;
    void changeScan(Dice& dice, fakes::FakeDiagnosticsClient& service) const;
    void changeStatus(Dice& dice, fakes::FakeDiagnosticsClient& service) const;

    Temper temper_;
    std::vector<std::string> names_;
    std::optional<std::string> joined_;
};

}  // namespace wp::monkey
