// ReadersWriterGate: many readers or one writer.
//
// The first reader in takes the writer gate for all readers, the last one
// out gives it back; a writer takes the gate itself. The gate is a
// semaphore, not a mutex, because the reader that gives it back need not be
// the one that took it. Waits have no time-out. Readers queue on the count's
// mutex while a writer holds the gate.
#pragma once

#include <cstdint>
#include <mutex>
#include <semaphore>

namespace hsdig {

class ReadersWriterGate {
 public:
  ReadersWriterGate() = default;
  ReadersWriterGate(const ReadersWriterGate&) = delete;
  ReadersWriterGate& operator=(const ReadersWriterGate&) = delete;

  void enterReader();
  void leaveReader();
  void enterWriter() { gate_.acquire(); }
  void leaveWriter() { gate_.release(); }

  class ReadGuard {
   public:
    explicit ReadGuard(ReadersWriterGate& g) : gate_(g) { gate_.enterReader(); }
    ~ReadGuard() { gate_.leaveReader(); }
    ReadGuard(const ReadGuard&) = delete;
    ReadGuard& operator=(const ReadGuard&) = delete;

   private:
    ReadersWriterGate& gate_;
  };

  class WriteGuard {
   public:
    explicit WriteGuard(ReadersWriterGate& g) : gate_(g) { gate_.enterWriter(); }
    ~WriteGuard() { gate_.leaveWriter(); }
    WriteGuard(const WriteGuard&) = delete;
    WriteGuard& operator=(const WriteGuard&) = delete;

   private:
    ReadersWriterGate& gate_;
  };

 private:
  std::mutex countMutex_;
  int32_t readers_ = 0;  // guarded by countMutex_
  std::counting_semaphore<0x7fffffff> gate_{1};
};

}  // namespace hsdig
