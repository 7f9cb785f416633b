#pragma once
// QelHostWebTaskQueue: the HTTP library's connection workers, as many as there are open
// connections, up to a cap. A fixed pool lets a few idle or trickling sockets hold every
// worker while the page's own request waits; here each connection gets a thread of its own
// at once, and threads beyond the few kept warm end after a while without work. At the cap,
// connections wait in order for a worker.
#include <httplib.h>

#include <chrono>
#include <condition_variable>
#include <deque>
#include <functional>
#include <list>
#include <mutex>
#include <thread>

class QelHostWebTaskQueue : public httplib::TaskQueue {
 public:
  QelHostWebTaskQueue(size_t warm, size_t cap, std::chrono::milliseconds linger);
  ~QelHostWebTaskQueue() override;

  void enqueue(std::function<void()> job) override;
  // Runs the queued jobs, then ends and joins every worker.
  void shutdown() override;

  size_t Threads() const;

 private:
  struct Worker {
    std::thread thread;
    bool finished = false;
  };
  void Work(Worker& self);
  // Joins the workers that ended; the mutex is held.
  void Reap();

  const size_t warm_, cap_;
  const std::chrono::milliseconds linger_;
  mutable std::mutex mutex_;
  std::condition_variable wake_;
  std::deque<std::function<void()>> jobs_;
  std::list<Worker> workers_;
  size_t idle_ = 0;
  size_t live_ = 0;
  bool shutdown_ = false;
};
