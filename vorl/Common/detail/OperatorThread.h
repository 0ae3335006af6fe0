#ifndef VORL_COMMON_DETAIL_OPERATORTHREAD_H
#define VORL_COMMON_DETAIL_OPERATORTHREAD_H

#include <atomic>
#include <condition_variable>
#include <memory>
#include <mutex>

#include <vorl/Common/OpBase.h>
#include <vorl/Platform/detail/Thread.h>

inline namespace vorl {
namespace vorl_detail {

/// The thread of an operator, shared by the copies of the operator that started it.
class OperatorThread {
 public:
  /// Makes a thread that will run `owner` after `Publish`; null when the system has none to give.
  /// `owner` must live until the thread has ended, which its destructor sees to.
  static std::shared_ptr<OperatorThread> Start(OpBase& owner);

  /// Lets the run begin, once the owner knows its thread.
  void Publish();
  /// True while the handle counts as open: the run goes on, or it has failed.
  bool IsOpen() const { return !m_released; }
  bool BelongsTo(const OpBase& op) const { return &m_owner == &op; }
  /// Ends the thread and returns when it is gone; called in the thread itself, it does not return.
  void End();

 private:
  explicit OperatorThread(OpBase& owner) : m_owner(owner) {}
  void Body();
  void DropLogContexts();

  OpBase& m_owner;  ///< dangles once the thread has ended
  std::unique_ptr<Thread> m_thread;
  // Not an atomic's own wait: where the standard library makes it of a mutex and a condition, a
  // notice that comes between the look and the wait is lost.
  std::mutex m_mutex;
  std::condition_variable m_changed;
  bool m_published = false;
  std::atomic<bool> m_released{false};
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
