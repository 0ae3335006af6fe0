#ifndef VORL_COMMON_DETAIL_OPERATORTHREAD_H
#define VORL_COMMON_DETAIL_OPERATORTHREAD_H

#include <atomic>
#include <memory>

#include <vorl/Common/OpBase.h>
#include <vorl/Platform/detail/Thread.h>

inline namespace vorl {

/// The thread of an operator, shared by the copies of the operator that started it.
class OperatorThread {
 public:
  /// Runs `owner` in a new thread; null when the system has none to give. `owner` must live until
  /// the thread has ended, which its destructor sees to.
  static std::shared_ptr<OperatorThread> Start(OpBase& owner);

  /// True while the handle counts as open: the run goes on, or it has failed.
  bool IsOpen() const { return !m_released; }
  /// Ends the thread and returns when it is gone; called in the thread itself, it does not return.
  void End();

 private:
  explicit OperatorThread(OpBase& owner) : m_owner(owner) {}
  void Body();
  void DropLogContexts();

  OpBase& m_owner;
  std::unique_ptr<vorl_detail::Thread> m_thread;
  std::atomic<bool> m_published{false};  ///< `m_thread` and the owner's handle are set
  std::atomic<bool> m_released{false};
  friend class OpBase;
};

}  // namespace vorl

#endif
