// SessionRegistry, LanguageAccessor and ReadersWriterGate.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <barrier>
#include <latch>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "session/IviWrapper.h"
#include "session/LanguageAccessor.h"

namespace hsdig {
namespace {

class FixedSession : public Session {
 public:
  explicit FixedSession(uint32_t language) : language_(language) {}
  uint32_t getLanguage() const override { return language_; }

 private:
  uint32_t language_;
};

class MockRegistry : public SessionRegistryInterface<Session> {
 public:
  MOCK_METHOD(void, add, (ViSession, std::shared_ptr<Session>), (override));
  MOCK_METHOD(void, remove, (ViSession), (override));
  MOCK_METHOD(std::shared_ptr<Session>, get, (ViSession), (override));
  MOCK_METHOD(std::shared_ptr<Session>, find, (ViSession), (override));
};

TEST(SessionRegistry, AddKeepsTheFirstObjectAndGetThrowsForAbsentHandles) {
  SessionRegistry<Session> registry;
  auto first = std::make_shared<FixedSession>(1);
  registry.add(7, first);
  registry.add(7, std::make_shared<FixedSession>(2));
  EXPECT_EQ(registry.get(7), first);
  EXPECT_EQ(registry.find(8), nullptr);
  try {
    registry.get(8);
    FAIL() << "no exception";
  } catch (const Exception& e) {
    EXPECT_EQ(e.status().code(), -1074130544);
  }
  registry.remove(8);  // absent: ignored
  registry.remove(7);
  EXPECT_EQ(registry.find(7), nullptr);
}

TEST(LanguageAccessor, SessionZeroGetsTheDefaultWithoutTheRegistry) {
  ::testing::StrictMock<MockRegistry> registry;
  LanguageAccessor<Session> accessor(registry, 3);
  IviWrapper none(0);
  EXPECT_EQ(accessor.getLanguage(none), 3u);
  accessor.setDefaultLanguage(5);
  EXPECT_EQ(accessor.getLanguage(none), 5u);
}

TEST(LanguageAccessor, RegisteredSessionsAnswerForThemselves) {
  SessionRegistry<Session> registry;
  registry.add(41, std::make_shared<FixedSession>(4));
  LanguageAccessor<Session> accessor(registry, 2);
  IviWrapper registered(41), other(42);
  EXPECT_EQ(accessor.getLanguage(registered), 4u);
  EXPECT_EQ(accessor.getLanguage(other), 2u);
}

TEST(LanguageAccessor, DefaultFromTheHostRuntime) {
  struct Case {
    std::optional<std::string> hostLanguage;
    uint32_t expected;
  };
  const Case cases[] = {{"French", 1},   {"German", 2},   {"Japanese", 3},
                        {"Korean", 4},   {"ChineseS", 5}, {"english", 0},
                        {"ChineseT", 0}, {"french", 0},   {std::nullopt, 0}};
  for (const auto& c : cases) {
    SCOPED_TRACE(c.hostLanguage.value_or("(no host runtime)"));
    EXPECT_EQ(defaultLanguageFromHost([&] { return c.hostLanguage; }), c.expected);
  }
  EXPECT_EQ(defaultLanguageFromHost(HostLanguageQuery()), 0u);
}

TEST(LanguageAccessor, TheProcessAccessorUsesTheProcessRegistry) {
  sessionRegistry().add(4242, std::make_shared<FixedSession>(5));
  IviWrapper registered(4242);
  EXPECT_EQ(languageAccessor().getLanguage(registered), 5u);
  sessionRegistry().remove(4242);
  EXPECT_EQ(&languageAccessor(), &languageAccessor());
}

TEST(ReadersWriterGate, ReadersShareAndAnotherThreadMayLetTheWriterIn) {
  ReadersWriterGate gate;
  constexpr int kReaders = 3;
  std::barrier allInside(kReaders);
  std::mutex logMutex;
  std::vector<std::string> log;
  auto note = [&](std::string what) {
    std::lock_guard lock(logMutex);
    log.push_back(std::move(what));
  };
  std::latch readersIn(kReaders);
  std::latch writerStarted(1);
  std::thread writer;
  std::vector<std::thread> readers;
  for (int i = 0; i < kReaders; ++i) {
    readers.emplace_back([&, i] {
      gate.enterReader();
      // Every reader is inside at once, or this barrier never completes.
      allInside.arrive_and_wait();
      readersIn.count_down();
      if (i == 0) writerStarted.wait();
      note("reader leaves");
      gate.leaveReader();
    });
  }
  readersIn.wait();
  writer = std::thread([&] {
    writerStarted.count_down();
    gate.enterWriter();
    note("writer in");
    gate.leaveWriter();
  });
  for (auto& t : readers) t.join();
  writer.join();
  ASSERT_EQ(log.size(), kReaders + 1u);
  EXPECT_EQ(log.back(), "writer in");
}

TEST(ReadersWriterGate, AWriterKeepsReadersOut) {
  ReadersWriterGate gate;
  gate.enterWriter();
  std::string order;
  std::latch started(1);
  std::thread reader([&] {
    started.count_down();
    ReadersWriterGate::ReadGuard guard(gate);
    order += "reader";
  });
  started.wait();
  order += "writer,";
  gate.leaveWriter();
  reader.join();
  EXPECT_EQ(order, "writer,reader");
}

}  // namespace
}  // namespace hsdig
