#include "platform/tools/executor.h"

#include <system_error>

namespace zor2 {

Executor::Executor(size_t threads) {
  workers_.reserve(threads);
  for (size_t i = 0; i < threads; ++i) {
    try {
      workers_.emplace_back([this] { Work(); });
    } catch (const std::system_error&) {
      break;  // the tasks then run on the threads that wait for them
    }
  }
}

Executor::~Executor() {
  {
    std::lock_guard<std::mutex> lock(mutex_);
    ending_ = true;
  }
  queued_.notify_all();
  for (std::thread& worker : workers_) worker.join();
  // Without workers, what is left in the queue runs here.
  while (!queue_.empty()) {
    std::shared_ptr<Job> job = std::move(queue_.front());
    queue_.pop_front();
    if (job->state == State::kQueued) job->Run();
  }
}

size_t Executor::MachineThreads() {
  const unsigned processors = std::thread::hardware_concurrency();
  return processors == 0 ? 1 : processors;
}

void Executor::Enqueue(std::shared_ptr<Job> job) {
  {
    std::lock_guard<std::mutex> lock(mutex_);
    queue_.push_back(std::move(job));
  }
  queued_.notify_one();
}

void Executor::Finish(Job& job) {
  std::unique_lock<std::mutex> lock(mutex_);
  if (job.state == State::kQueued) {
    // Left in the queue: the worker that takes it passes it over.
    job.state = State::kRunning;
    lock.unlock();
    RunClaimed(job);
    return;
  }
  done_.wait(lock, [&job] { return job.state == State::kDone; });
}

void Executor::RunClaimed(Job& job) {
  job.Run();
  {
    std::lock_guard<std::mutex> lock(mutex_);
    job.state = State::kDone;
  }
  done_.notify_all();
}

void Executor::Work() {
  for (;;) {
    std::shared_ptr<Job> job;
    {
      std::unique_lock<std::mutex> lock(mutex_);
      queued_.wait(lock, [this] { return ending_ || !queue_.empty(); });
      if (queue_.empty()) return;  // ending, and nothing is left
      job = std::move(queue_.front());
      queue_.pop_front();
      if (job->state != State::kQueued) continue;  // run by the thread that waited for it
      job->state = State::kRunning;
    }
    RunClaimed(*job);
    // The job goes here, and with it what its task still owned.
  }
}

}  // namespace zor2
