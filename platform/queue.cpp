#include "platform/queue.h"

namespace wp {
namespace {
thread_local Queue* currentQueue = nullptr;
}  // namespace

Queue* Queue::current() {
    return currentQueue;
}

void Queue::setCurrent(Queue* queue) {
    currentQueue = queue;
}

}  // namespace wp
