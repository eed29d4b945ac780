// Two threads on one session are serialised by the engine's session lock;
// sessions of their own run side by side.
#include <atomic>
#include <latch>
#include <mutex>
#include <thread>

#include "DigitizerTestSupport.h"

namespace hsdig::test {
namespace {

using ConcurrencyTest = DigitizerTest;

TEST_F(ConcurrencyTest, ACallWaitsForTheThreadThatHoldsTheSessionLock) {
  std::mutex m;
  std::vector<std::string> events;
  auto note = [&](const char* e) {
    std::lock_guard lock(m);
    events.push_back(e);
  };
  ViBoolean locked = VI_FALSE;
  ASSERT_EQ(Ivi_LockSession(vi, &locked), VI_SUCCESS);
  std::latch started(1);
  ViStatus otherStatus = -1;
  std::thread other([&] {
    started.count_down();
    otherStatus = hsdig_ConfigureVertical(vi, "0", 5.0, 0.0, HSDIG_VAL_DC, 1.0, VI_TRUE);
    note("other returned");
  });
  started.wait();
  // Give the other thread every chance to run into the lock.
  for (int i = 0; i < 1000; ++i) std::this_thread::yield();
  // While this thread holds the lock the range is still the default, and
  // this thread's own change goes through.
  ASSERT_EQ(hsdig_SetAttributeViReal64(vi, "0", HSDIG_ATTR_VERTICAL_RANGE, 2.0), VI_SUCCESS);
  note("holder unlocking");
  ASSERT_EQ(Ivi_UnlockSession(vi, &locked), VI_SUCCESS);
  other.join();
  EXPECT_EQ(otherStatus, VI_SUCCESS);
  ASSERT_EQ(events.size(), 2u);
  EXPECT_EQ(events[0], "holder unlocking");
  EXPECT_EQ(real(HSDIG_ATTR_VERTICAL_RANGE, "0"), 5.0) << "the waiting call ran last";
}

TEST(DigitizerThreads, ManyThreadsOnOneSessionKeepItConsistent) {
  ViSession vi = openSession();
  constexpr int kThreads = 4, kRounds = 30;
  std::latch go(kThreads);
  std::atomic<int> failures{0};
  std::vector<std::thread> threads;
  for (int t = 0; t < kThreads; ++t) {
    threads.emplace_back([&, t] {
      go.arrive_and_wait();
      std::vector<double> wfm(1000);
      hsdigWfmInfo info{};
      for (int r = 0; r < kRounds; ++r) {
        std::string ch = std::to_string(t);
        if (hsdig_SetAttributeViReal64(vi, ch.c_str(), HSDIG_ATTR_SIGNAL_AMPLITUDE,
                                       0.1 + 0.01 * r) != VI_SUCCESS)
          ++failures;
        if (hsdig_Read(vi, ch.c_str(), 5.0, 1000, wfm.data(), &info) != VI_SUCCESS) ++failures;
        if (info.actualSamples != 1000) ++failures;
      }
    });
  }
  for (auto& th : threads) th.join();
  EXPECT_EQ(failures.load(), 0);
  EXPECT_EQ(hsdig_close(vi), VI_SUCCESS);
}

}  // namespace
}  // namespace hsdig::test
