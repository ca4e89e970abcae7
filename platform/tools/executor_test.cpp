#include "platform/tools/executor.h"

#include <gtest/gtest.h>

#include <atomic>
#include <stdexcept>
#include <thread>
#include <vector>

namespace zor2 {
namespace {

// Whatever the workers, every task runs once, results come back to their
// handles, and tasks nobody waits for have run when the executor ends.
TEST(ExecutorTest, RunsEveryTaskOnceWithAnyNumberOfWorkers) {
  for (size_t threads : {0, 1, 2, 8}) {
    std::atomic<int> posted{0};
    std::vector<int> results;
    {
      Executor executor(threads);
      EXPECT_EQ(executor.threads(), threads);
      std::vector<Executor::Handle<int>> handles;
      for (int i = 0; i < 100; ++i) {
        handles.push_back(executor.Submit([i] { return i * i; }));
        executor.Post([&posted] { ++posted; });
      }
      for (Executor::Handle<int>& handle : handles) results.push_back(handle.Get());
    }
    EXPECT_EQ(posted, 100) << threads;
    for (int i = 0; i < 100; ++i) EXPECT_EQ(results[i], i * i) << threads;
  }
}

// A task may wait for tasks queued behind it: with one worker busy with the
// first, the others run on the thread that waits for them.
TEST(ExecutorTest, TasksWaitingForQueuedTasksDoNotBlock) {
  Executor executor(1);
  Executor::Handle<int> inner;
  Executor::Handle<int> outer = executor.Submit([&executor, &inner] {
    inner = executor.Submit([] { return 1; });
    return inner.Get() + 1;
  });
  EXPECT_EQ(outer.Get(), 2);
}

TEST(ExecutorTest, HandsATaskExceptionToItsHandle) {
  Executor executor(2);
  Executor::Handle<void> failing = executor.Submit([] { throw std::runtime_error("no"); });
  EXPECT_THROW(failing.Get(), std::runtime_error);
  executor.Post([] { throw std::runtime_error("dropped"); });
}

}  // namespace
}  // namespace zor2
