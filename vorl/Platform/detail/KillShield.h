#ifndef VORL_PLATFORM_DETAIL_KILLSHIELD_H
#define VORL_PLATFORM_DETAIL_KILLSHIELD_H

inline namespace vorl {
namespace vorl_detail {

/// While one lives, `Thread::Kill` puts off ending the thread that made it. Shields nest. They
/// stand around the few instructions after which others could not go on: what is shielded is short
/// and never waits for the application.
class KillShield {
 public:
  KillShield();
  KillShield(const KillShield&) = delete;
  KillShield& operator=(const KillShield&) = delete;
  ~KillShield();
};

}  // namespace vorl_detail
}  // namespace vorl

#endif
