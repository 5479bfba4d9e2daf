#pragma once
// Ends the test program when a test runs past its time, so that a window left waiting for
// input cannot hang the suite.

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <thread>

namespace zv::test {

class Watchdog {
  public:
    explicit Watchdog(std::chrono::seconds limit = std::chrono::seconds(20));
    ~Watchdog();
    Watchdog(const Watchdog&) = delete;
    Watchdog& operator=(const Watchdog&) = delete;

  private:
    std::mutex mutex_;
    std::condition_variable done_;
    bool finished_ = false;
    std::thread thread_;
};

}  // namespace zv::test
