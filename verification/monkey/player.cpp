#include "verification/monkey/player.h"

namespace wp::monkey {

using namespace fakes;
using ui::Key;

Player::Player(Dice& dice, FakeServices& services, Platform& platform, ui::Screen& screen)
    : dice_(dice),
      services_(services),
      screen_(screen),
      temper_(dice.percent(40) ? Temper::calm : Temper::wild),
      air_(dice, temper_) {
    air_.change(dice, services.service);
    services.wifi.setHasRadio(!dice.percent(2));
    if (dice.percent(2)) services.wifi.setDeviceNames({});
    services.wifi.setInitialPower(temper_ == Temper::wild && dice.percent(20) ? 0 : 1);
    services.wifi.setObeysSetPower(dice.percent(80));
    std::optional<std::string> name;
    if (dice.percent(30)) name = air_.name(dice).substr(0, 32);
    controller_ =
        controllerFor(platform, request(dice.percent(85) ? NetworkList::shown : NetworkList::hidden, name));
    screen.setRootViewController(controller_);
    screen.setBackHandler([this] { hasLeft_ = true; });
}

Player::~Player() {
    screen_.setBackHandler(nullptr);
    screen_.setRootViewController(nullptr);
}

void Player::act() {
    int what = dice_.below(100);
    if (what < 8) {
        typeOther();
    } else if (what < 60) {
        pressKey();
    } else if (what < 72) {
        screen_.typeText(air_.name(dice_));
    } else if (what < 74) {
        screen_.clearText();
    } else if (what < 90) {
        air_.change(dice_, services_.service);
    } else if (what < 93) {
        turnPower();
    }
}

void Player::pressKey() {
    static const std::vector<Key> keys = {
        Key::up,   Key::up,    Key::down,   Key::down,          Key::down,
        Key::left, Key::right, Key::select, Key::select,        Key::select,
        Key::home, Key::end,   Key::back,   Key::deleteForward, Key::backspace};
    Key key = dice_.oneOf(keys);
    // Leaving ends the life: most of the time the monkey stays.
    if (key == Key::back && !screen_.alert() && !dice_.percent(5)) return;
    screen_.press(key);
}

/// What single random keys hardly ever amount to.
void Player::typeOther() {
    ui::SettingsTableView* table = screen_.table();
    if (!table || screen_.alert()) return;
    table->focusRow({0, 2});
    screen_.press(Key::select);
    screen_.typeText(air_.name(dice_));
    for (Key key : {Key::down, Key::down, Key::select}) screen_.press(key);
}

void Player::turnPower() {
    bool isOn = services_.wifi.power() != 0;
    // Power that comes on again on a list already shown makes the table repair itself; off ends the run.
    int power = temper_ == Temper::wild && dice_.percent(isOn ? 85 : 95) ? 1 : 0;
    if (power == 0 && !dice_.percent(20)) return;
    services_.wifi.turnPower(power);
}

void Player::check() {
    checkTable(screen_, *controller_);
    if (temper_ == Temper::calm) checkCalm(screen_, *controller_);
}

}  // namespace wp::monkey
