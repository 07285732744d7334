#pragma once

#include <unistd.h>

#include <utility>

namespace wp {

/// An open file descriptor that is closed with its owner, or none.
class Descriptor {
  public:
    explicit Descriptor(int number = -1) : number_(number) {}
    Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
    Descriptor& operator=(Descriptor&& other) noexcept {
        if (this != &other) {
            close();
            number_ = std::exchange(other.number_, -1);
        }
        return *this;
    }
    ~Descriptor() { close(); }

    int number() const { return number_; }
    /// Whether it is open.
    explicit operator bool() const { return number_ >= 0; }
    /// Whether closing told of no error; harmless when nothing is open.
    bool close() { return number_ < 0 || ::close(std::exchange(number_, -1)) == 0; }

  private:
    int number_;
};

}  // namespace wp
