#include "platform/runtime/Dispatch.h"

#include <condition_variable>
#include <deque>
#include <thread>

namespace tavro {

struct GlobalQueue::State {
  mutable std::mutex mutex;
  std::condition_variable changed;
  std::deque<std::function<void()>> waiting;
  std::size_t queued = 0;
  bool busy = false;
  bool held = false;
  bool ending = false;
  std::thread worker;

  void run() {
    std::unique_lock lock(mutex);
    while (true) {
      changed.wait(lock, [this] { return ending || (!held && !waiting.empty()); });
      if (waiting.empty()) {
        return;
      }
      std::function<void()> work = std::move(waiting.front());
      waiting.pop_front();
      busy = true;
      lock.unlock();
      work();
      work = nullptr;  // what it held may queue more as it goes
      lock.lock();
      busy = false;
      changed.notify_all();
    }
  }
};

GlobalQueue& GlobalQueue::shared() {
  static GlobalQueue queue;
  return queue;
}

GlobalQueue::GlobalQueue() : state_(new State) {}

GlobalQueue::~GlobalQueue() {
  {
    const std::lock_guard lock(state_->mutex);
    state_->ending = true;
  }
  state_->changed.notify_all();
  if (state_->worker.joinable()) {
    state_->worker.join();
  }
  delete state_;
}

void GlobalQueue::async(std::function<void()> work) {
  {
    const std::lock_guard lock(state_->mutex);
    state_->waiting.push_back(std::move(work));
    ++state_->queued;
    if (!state_->worker.joinable()) {
      state_->worker = std::thread([state = state_] { state->run(); });
    }
  }
  state_->changed.notify_all();
}

void GlobalQueue::hold() {
  const std::lock_guard lock(state_->mutex);
  state_->held = true;
}

void GlobalQueue::release() {
  {
    const std::lock_guard lock(state_->mutex);
    state_->held = false;
  }
  state_->changed.notify_all();
}

void GlobalQueue::drain() {
  std::unique_lock lock(state_->mutex);
  state_->changed.wait(lock, [this] { return state_->waiting.empty() && !state_->busy; });
}

std::size_t GlobalQueue::queuedCount() const {
  const std::lock_guard lock(state_->mutex);
  return state_->queued;
}

}  // namespace tavro
