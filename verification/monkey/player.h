#pragma once

#include <memory>

#include "verification/monkey/checks.h"
#include "verification/monkey/neighbourhood.h"

namespace wp::monkey {

/// What the monkey does to a run whatever turns its queues: keys, texts, power, air.
class Player {
  public:
    Player(Dice& dice, fakes::FakeServices& services, Platform& platform, ui::Screen& screen);
    ~Player();

    void start() { controller_->start(); }
    /// One random event from outside. *Main*.
    void act();
    /// Whether the viewer left, or the run is over.
    bool isOver() const { return hasLeft_ || controller_->isFinished(); }
    bool hasLeft() const { return hasLeft_; }
    /// After every event and at the end. *Main*.
    void check();

    WiFiProfileViewController& controller() { return *controller_; }
    Temper temper() const { return temper_; }

  private:
    void pressKey();
    void typeOther();
    void turnPower();

    Dice& dice_;
    fakes::FakeServices& services_;
    ui::Screen& screen_;
    Temper temper_;
    Neighbourhood air_;
    bool hasLeft_ = false;
    std::shared_ptr<WiFiProfileViewController> controller_;
};

}  // namespace wp::monkey
