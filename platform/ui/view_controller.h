#pragma once

#include <memory>

namespace wp::ui {

/// The base of a controller that owns one screen's views. *Main*.
class ViewController : public std::enable_shared_from_this<ViewController> {
  public:
    virtual ~ViewController() = default;
};

}  // namespace wp::ui
