#include "QelHostWebTaskQueue.h"

QelHostWebTaskQueue::QelHostWebTaskQueue(size_t warm, size_t cap, std::chrono::milliseconds linger)
    : warm_(warm), cap_(cap < 1 ? 1 : cap), linger_(linger) {}

QelHostWebTaskQueue::~QelHostWebTaskQueue() { shutdown(); }

void QelHostWebTaskQueue::enqueue(std::function<void()> job) {
  std::lock_guard lock(mutex_);
  Reap();
  jobs_.push_back(std::move(job));
  // A job more than the idle workers can take gets a thread of its own, so a busy worker
  // (a slow client) never delays the next connection.
  if (jobs_.size() > idle_ && live_ < cap_) {
    Worker& worker = workers_.emplace_back();
    ++live_;
    worker.thread = std::thread([this, &worker] { Work(worker); });
  } else {
    wake_.notify_one();
  }
}

void QelHostWebTaskQueue::Work(Worker& self) {
  std::unique_lock lock(mutex_);
  for (;;) {
    ++idle_;
    const bool woken = wake_.wait_for(lock, linger_, [this] { return !jobs_.empty() || shutdown_; });
    --idle_;
    if (jobs_.empty()) {
      if (shutdown_ || (!woken && live_ > warm_)) break;
      continue;
    }
    std::function<void()> job = std::move(jobs_.front());
    jobs_.pop_front();
    lock.unlock();
    job();
    lock.lock();
  }
  --live_;
  self.finished = true;
}

void QelHostWebTaskQueue::Reap() {
  for (auto it = workers_.begin(); it != workers_.end();) {
    if (!it->finished) {
      ++it;
      continue;
    }
    // It set `finished` as its last step under the mutex; only its return is left.
    it->thread.join();
    it = workers_.erase(it);
  }
}

void QelHostWebTaskQueue::shutdown() {
  std::unique_lock lock(mutex_);
  if (shutdown_ && workers_.empty()) return;
  shutdown_ = true;
  wake_.notify_all();
  // Workers finish the queued jobs first; joining needs the mutex free.
  std::list<Worker> all;
  all.splice(all.end(), workers_);
  lock.unlock();
  for (Worker& worker : all) worker.thread.join();
}

size_t QelHostWebTaskQueue::Threads() const {
  std::lock_guard lock(mutex_);
  return live_;
}
