#pragma once

#include <chrono>
#include <functional>

namespace wp {

using Block = std::function<void()>;

/// A place to which blocks are submitted. A block keeps alive what it captures. *Any* thread.
class Queue {
  public:
    virtual ~Queue() = default;

    /// Submits the block and returns at once.
    virtual void async(Block block) = 0;

    /// Submits the block once the delay has passed; returns at once.
    virtual void after(std::chrono::milliseconds delay, Block block) = 0;

    /// Submits the block and returns when it has run. It runs in the caller's place, on the caller's thread,
    /// so that the current run loop inside the block is the caller's, and a caller that waits cannot keep it
    /// from running.
    void sync(const Block& block) { block(); }

    /// The queue that the calling thread drains as its run loop; null on a thread that drains none.
    static Queue* current();

  protected:
    /// Makes this queue the calling thread's run loop (null: none).
    static void setCurrent(Queue* queue);
};

}  // namespace wp
