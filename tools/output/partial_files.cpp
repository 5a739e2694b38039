#include "partial_files.h"

#include <atomic>
#include <memory>
#include <stdexcept>
#include <unistd.h>

namespace tool_output {

namespace {

constexpr int kSignals[] = {SIGINT, SIGTERM, SIGHUP, SIGPIPE};

// Read by the handler: only lock-free atomics and unlink(), which are safe
// in a signal handler. Slots are never reused, so a slot's path is either
// the live string or null.
std::unique_ptr<std::atomic<const char*>[]> slots;
std::size_t capacity = 0;
std::size_t used = 0;

static_assert(std::atomic<const char*>::is_always_lock_free);

extern "C" void RemovePartialFiles(int signal) {
  for (std::size_t i = 0; i < capacity; ++i) {
    if (const char* path = slots[i].load()) unlink(path);
  }
  // The handler was reset on entry (SA_RESETHAND): this ends the run as the
  // signal would have, once the handler returns and the signal is unblocked.
  raise(signal);
}

sigset_t WatchedSignals() {
  sigset_t set;
  sigemptyset(&set);
  for (int signal : kSignals) sigaddset(&set, signal);
  return set;
}

}  // namespace

void WatchPartialFiles(std::size_t count) {
  slots = std::make_unique<std::atomic<const char*>[]>(count);
  for (std::size_t i = 0; i < count; ++i) slots[i].store(nullptr);
  capacity = count;
  struct sigaction action {};
  action.sa_handler = &RemovePartialFiles;
  action.sa_mask = WatchedSignals();
  action.sa_flags = SA_RESETHAND;
  for (int signal : kSignals) {
    struct sigaction previous {};
    // A signal ignored by whoever started the run stays ignored.
    if (sigaction(signal, nullptr, &previous) == 0 && previous.sa_handler == SIG_IGN) continue;
    sigaction(signal, &action, nullptr);
  }
}

std::size_t AddPartialFile(const char* path) {
  if (used >= capacity) throw std::logic_error("more partial files than watched");
  slots[used].store(path);
  return used++;
}

void ForgetPartialFile(std::size_t slot) { slots[slot].store(nullptr); }

SignalsHeld::SignalsHeld() {
  const sigset_t set = WatchedSignals();
  sigprocmask(SIG_BLOCK, &set, &saved_);
}

SignalsHeld::~SignalsHeld() { sigprocmask(SIG_SETMASK, &saved_, nullptr); }

}  // namespace tool_output
