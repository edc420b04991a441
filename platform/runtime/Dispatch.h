#pragma once

#include <functional>
#include <mutex>

namespace tavro {

/// Runs `work` once per token, however often and from whichever thread it is asked.
using OnceToken = std::once_flag;
template <class F>
void dispatchOnce(OnceToken& token, F&& work) {
  std::call_once(token, std::forward<F>(work));
}

/// The default-priority global queue: one worker thread, started by its first work. What crosses
/// to it is plain data, since objects live on one thread.
class GlobalQueue {
 public:
  static GlobalQueue& shared();
  GlobalQueue(const GlobalQueue&) = delete;
  GlobalQueue& operator=(const GlobalQueue&) = delete;

  /// Queues work and returns at once.
  void async(std::function<void()> work);
  /// Keeps queued work waiting until `release`.
  void hold();
  void release();
  /// Returns when everything queued so far is done. Not to be called while the queue is held.
  void drain();
  /// How much work was ever queued.
  [[nodiscard]] std::size_t queuedCount() const;

 private:
  GlobalQueue();
  ~GlobalQueue();
  struct State;
  State* state_;
};

}  // namespace tavro
