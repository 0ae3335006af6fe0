#ifndef BENCH_PEERS_CONTEST_H
#define BENCH_PEERS_CONTEST_H

/// @file
/// What is compared: works, and who does them.

#include <functional>
#include <string>

namespace peers {

/// Something to be computed, whoever computes it.
struct Work {
  std::string name;  ///< such as "mpr/linear/oblique"; `report.py` knows them all
  double samples;    ///< or pixels that one run yields, looks at or moves
};

/// One way of doing a work, ready to start: memory is there, files are written.
struct Contender {
  /// The call that is timed. False where it failed.
  std::function<bool()> run;
  /// What is wrong with the result of the last run; empty where it is right.
  std::function<std::string()> check;
};

/// Enters a contender for a work. `name` is that of a library, "plain" for a loop as one writes it
/// without thinking of speed, or that of the function that sets the pace, such as "memcpy".
/// `prepare` runs when its turn comes; what it makes goes before the next one's turn.
///
/// A contender's figures count only while its result is right: it is checked before the time is
/// taken, and a wrong one is reported as an error.
void Enter(const Work& work, const std::string& name, std::function<Contender()> prepare);

/// Turns all that was entered into benchmarks, work after work, so that those who do the same work
/// follow upon each other. Each takes the processor time of the whole process: all of a contender's
/// threads count.
void RegisterBenchmarks();

/// Enters what each library can do. Those of libraries that are not here are not built.
void EnterPlainImages();
void EnterPlainVolumes();
void EnterPlainFiles();
void EnterVorlImages();
void EnterVorlVolumes();
void EnterVorlFiles();
void EnterOpenCv();
void EnterVtkFilters();
void EnterVtkReslice();
void EnterLibyuv();

}  // namespace peers

#endif
