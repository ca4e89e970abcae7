#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <future>
#include <memory>
#include <mutex>
#include <thread>
#include <type_traits>
#include <utility>
#include <vector>

namespace zor2 {

// The worker threads of a run, started once, through which every background
// task goes. Tasks are taken in the order they were handed over. A task that
// no worker has started by the time its result is asked for runs on the
// thread that asks instead: waiting never depends on the order of the queue,
// a task may wait for others without tying up the workers, and a run whose
// threads could not be started still does all its work, on the thread that
// waits. Tasks nobody waits for (Post) run all the same: the executor's end
// waits for them.
//
// Thread safety: Submit, Post and Handle::Get may be called from any thread,
// workers included; the executor itself is made and ended by one thread.
class Executor {
  struct Job;

 public:
  // The future result of a task handed to Submit.
  template <typename Result>
  class Handle {
   public:
    Handle() = default;
    bool valid() const { return job_ != nullptr; }
    // The task's result (or its exception), once it has run: on this thread
    // when no worker has started it yet.
    // REQUIRES: valid(); called once.
    Result Get() {
      executor_->Finish(*job_);
      job_.reset();
      return result_.get();
    }

   private:
    friend class Executor;
    Executor* executor_ = nullptr;
    std::shared_ptr<Job> job_;
    std::future<Result> result_;
  };

  // An executor with `threads` workers, or fewer when the system starts fewer.
  explicit Executor(size_t threads);
  Executor(const Executor&) = delete;
  Executor& operator=(const Executor&) = delete;
  // Waits for every task handed over, running those no worker has started.
  ~Executor();

  // The number of processors the machine offers this process (at least 1).
  static size_t MachineThreads();
  // The workers that were started.
  size_t threads() const { return workers_.size(); }

  // Hands `task` (callable without arguments) over and returns its handle.
  template <typename Task>
  auto Submit(Task task) {
    using Result = std::invoke_result_t<Task&>;
    auto job = std::make_shared<TaskJob<Result>>(std::move(task));
    Handle<Result> handle;
    handle.executor_ = this;
    handle.job_ = job;
    handle.result_ = job->task.get_future();
    Enqueue(std::move(job));
    return handle;
  }

  // Hands `task` over without a handle: nobody waits for it but the
  // executor's end. Its exceptions are dropped.
  template <typename Task>
  void Post(Task task) {
    Enqueue(std::make_shared<TaskJob<void>>(std::move(task)));
  }

 private:
  enum class State { kQueued, kRunning, kDone };
  struct Job {
    virtual ~Job() = default;
    virtual void Run() = 0;
    State state = State::kQueued;  // guarded by the executor's mutex_
  };
  template <typename Result>
  struct TaskJob : Job {
    template <typename Task>
    explicit TaskJob(Task body) : task(std::move(body)) {}
    void Run() override { task(); }
    std::packaged_task<Result()> task;
  };

  void Enqueue(std::shared_ptr<Job> job);
  // Runs `job` here if nobody has started it, else waits until it is done.
  void Finish(Job& job);
  // Runs a job taken from the queue (claimed: state kRunning) and marks it done.
  void RunClaimed(Job& job);
  void Work();

  std::mutex mutex_;
  std::condition_variable queued_;  // a job was queued, or the end has come
  std::condition_variable done_;    // a job is done
  std::deque<std::shared_ptr<Job>> queue_;
  bool ending_ = false;
  std::vector<std::thread> workers_;
};

}  // namespace zor2
