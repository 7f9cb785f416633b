#pragma once
// QelStepChildProcess: runs one piece of work in a forked child under limits of processor
// time and memory, and hands back the bytes it produced and how it ended. A crash, a stall
// or a runaway allocation in the work ends the child, never the caller. The work sees a
// copy of the caller's memory; nothing it changes comes back but its bytes.
#include <functional>
#include <string>

class QelStepChildProcess {
 public:
  QelStepChildProcess() = delete;

  struct Limits {
    double cpuSeconds = 60.0;
    size_t memoryBytes = 0;  // 0: no limit
    double wallSeconds = 120.0;
  };

  struct Outcome {
    bool finished = false;  // the work returned and its bytes all arrived
    int signal = 0;         // the signal that ended the child, or 0
    bool outOfTime = false; // processor time or the wall clock ran out
    std::string bytes;
    std::string failure;    // why the child could not be started or watched
  };

  static Outcome Run(const std::function<std::string()>& work, const Limits& limits);
};
