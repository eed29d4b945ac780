// The parts of a worker on their own: the thread pool and the controller's
// room accounting and job queue.
#include <poll.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

#include "contract/Diagnostics.h"
#include "server/HandleWaitPolicy.h"
#include "server/IOTaskController.h"
#include "server/ServerFixture.h"
#include "server/SingleTaskThreadPool.h"

namespace hsdig {
namespace {

TEST(SingleTaskThreadPool, RunsEveryThreadAndJoinsAfterStop) {
  SingleTaskThreadPool pool;
  std::atomic<int> ran{0};
  test::Latch go;
  pool.setRunnable([&] {
    ++ran;
    go.wait();
  });
  pool.addThreads(3);
  EXPECT_EQ(pool.activeCount(), 3u);
  go.open();
  pool.stop();
  pool.join();
  EXPECT_EQ(ran.load(), 3);
  EXPECT_EQ(pool.activeCount(), 0u);
  pool.addThreads(2);
  EXPECT_EQ(pool.activeCount(), 0u) << "a stopped pool starts nothing";
}

TEST(SingleTaskThreadPool, RetiredThreadsAreJoinedLater) {
  SingleTaskThreadPool pool;
  std::atomic<int> retired{0};
  pool.setRunnable([&] {
    pool.retireThread(std::this_thread::get_id());
    ++retired;
  });
  pool.addThreads(2);
  while (retired.load() < 2) std::this_thread::yield();
  EXPECT_EQ(pool.activeCount(), 0u);
  // The next addThreads joins the parked threads; join takes the rest.
  pool.setRunnable([] {});
  pool.addThreads(1);
  pool.stop();
  pool.join();
}

TEST(SingleTaskThreadPool, RetiringAnotherThreadJoinsIt) {
  SingleTaskThreadPool pool;
  test::Latch started;
  std::atomic<std::thread::id> id{};
  pool.setRunnable([&] {
    id = std::this_thread::get_id();
    started.open();
  });
  pool.addThreads(1);
  started.wait();
  pool.retireThread(id.load());
  EXPECT_EQ(pool.activeCount(), 0u);
  pool.retireThread(std::thread::id());  // unknown: nothing
  pool.stop();
  pool.join();
}

std::vector<std::string> lines;
void keepLine(const char* line) {
  lines.emplace_back(line);
}

struct NullTask : IOTask {
  int getWaitHandle() override { return -1; }
  void process(UniqueGuard&) override {}
};

TEST(IOTaskController, KeepsAWorkerAtSixtyFourTasks) {
  SingleTaskThreadPool pool;
  IOMultiTask<PollWaitPolicy> multi(pool);
  auto controller = std::make_shared<IOTaskController<PollWaitPolicy>>(multi, 2);
  UniqueGuard guard(multi.waitLock());
  multi.addIOTask(controller, guard);
  guard.unlock();

  std::vector<std::shared_ptr<NullTask>> tasks;
  int accepted = 0;
  for (int i = 0; i < 70; ++i) {
    tasks.push_back(std::make_shared<NullTask>());
    accepted += controller->tryAddTask(tasks.back()) ? 1 : 0;
  }
  EXPECT_EQ(accepted, 62);
  EXPECT_EQ(controller->taskCount(), 64);

  // The controller's event is set until the leader runs the queued jobs.
  pollfd probe{controller->getWaitHandle(), POLLIN, 0};
  EXPECT_EQ(::poll(&probe, 1, 0), 1);
  guard.lock();
  controller->process(guard);
  EXPECT_FALSE(guard.owns_lock());
  EXPECT_EQ(multi.taskCountUnlocked(), 63u);
  EXPECT_EQ(::poll(&probe, 1, 0), 0) << "the event is reset by the run";

  controller->scheduleRemoval(tasks[0].get());
  EXPECT_EQ(controller->taskCount(), 63);
  guard.lock();
  controller->process(guard);
  EXPECT_EQ(multi.taskCountUnlocked(), 62u);

  diagnostics::installSink(&keepLine);
  guard.lock();
  multi.removeIOTask(tasks[0].get(), guard);
  diagnostics::installSink(&diagnostics::discard);
  ASSERT_FALSE(lines.empty());
  EXPECT_EQ(lines.back(), "IOMultiTask::removeIOTask connection is double dead");

  multi.shutdown(guard);
  EXPECT_TRUE(multi.stopped());
  EXPECT_EQ(multi.taskCountUnlocked(), 0u);
}

TEST(PollWaitPolicy, ReportsTheLowestReadyHandleOrATimeOut) {
  int pipeA[2], pipeB[2];
  ASSERT_EQ(::pipe(pipeA), 0);
  ASSERT_EQ(::pipe(pipeB), 0);
  int handles[] = {-1, pipeA[0], pipeB[0]};
  EXPECT_EQ(PollWaitPolicy::wait_for_multiple(handles, 3, 0), -1);
  ASSERT_EQ(::write(pipeB[1], "x", 1), 1);
  EXPECT_EQ(PollWaitPolicy::wait_for_multiple(handles, 3, 0), 2);
  ASSERT_EQ(::write(pipeA[1], "x", 1), 1);
  EXPECT_EQ(PollWaitPolicy::wait_for_multiple(handles, 3, 0), 1);
  for (int fd : {pipeA[0], pipeA[1], pipeB[0], pipeB[1]}) ::close(fd);
}

}  // namespace
}  // namespace hsdig
