#include "watchdog.h"

#include <cstdio>
#include <cstdlib>

namespace zv::test {

Watchdog::Watchdog(std::chrono::seconds limit)
    : thread_([this, limit] {
          std::unique_lock lock(mutex_);
          if (!done_.wait_for(lock, limit, [this] { return finished_; })) {
              std::fprintf(stderr, "watchdog: test still running after %lld s\n",
                           static_cast<long long>(limit.count()));
              std::_Exit(3);
          }
      }) {}

Watchdog::~Watchdog() {
    {
        std::lock_guard lock(mutex_);
        finished_ = true;
    }
    done_.notify_all();
    thread_.join();
}

}  // namespace zv::test
