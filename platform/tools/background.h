#pragma once

#include <future>
#include <system_error>
#include <type_traits>
#include <utility>

namespace zor2 {

// Runs `task` on a thread of its own and returns the future of its result.
// Should no thread be available, a task that can be copied runs on the thread
// that first waits for its result instead, so that the program goes on either
// way; a task that cannot be copied is then dropped unrun (the discarding of
// memory, whose work its destruction does all the same).
template <typename Task>
auto RunInBackground(Task task) {
  try {
    if constexpr (std::is_copy_constructible_v<Task>) {
      return std::async(std::launch::async, task);
    } else {
      return std::async(std::launch::async, std::move(task));
    }
  } catch (const std::system_error&) {
    return std::async(std::launch::deferred, std::move(task));
  }
}

}  // namespace zor2
