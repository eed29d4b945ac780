// Compares our concurrent pipe server with a raw Unix-socket ping-pong and
// with the stock threaded Thrift server over the same contract and handler.
// Each server runs in a child process of its own, so its threads and memory
// are measured alone; the clients run here.
//
//   bench_server [--quick] [--only raw|stock|ours]
#include <sys/socket.h>
#include <sys/un.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <functional>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include <thrift/protocol/TBinaryProtocol.h>
#include <thrift/server/TThreadedServer.h>
#include <thrift/transport/TBufferTransports.h>
#include <thrift/transport/TServerSocket.h>
#include <thrift/transport/TSocket.h>

#include "contract/Diagnostics.h"
#include "contract/TBulkStringBinaryProtocol.h"
#include "contract/TransportConfiguration.h"
#include "hsdigEP.h"
#include "server/Server.h"
#include "transport/FramedClient.h"
#include "transport/PipeName.h"
#include "transport/TPipe.h"

namespace {

using Clock = std::chrono::steady_clock;
using apache::thrift::protocol::TProtocol;
using apache::thrift::transport::TTransport;

double secondsSince(Clock::time_point start) {
  return std::chrono::duration<double>(Clock::now() - start).count();
}

// The handler of both servers: "reset" echoes, "omniReadOrFetch" answers with
// numSamples bytes of a prepared block.
class BenchHandler : public hsdig::hsdigEPNull {
 public:
  void reset(hsdig::RetStatus& ret, int32_t vi) override { ret.code = vi; }
  void omniReadOrFetch(hsdig::RetWfmRecords& ret, int32_t, const std::string&, double,
                       int32_t numSamples, int32_t, bool, bool, bool) override {
    ret.numRecords = 1;
    ret.numPoints = numSamples;
    ret.wfmData.assign(static_cast<size_t>(numSamples), '\x5a');
  }
};

// ---------------------------------------------------------------------------
// Server processes

struct ServerProcess {
  pid_t pid = -1;
  int control = -1;  // closing it tells the child to exit

  long statusField(const char* key) const {
    std::ifstream in("/proc/" + std::to_string(pid) + "/status");
    std::string line;
    while (std::getline(in, line)) {
      if (line.rfind(key, 0) == 0) return std::atol(line.c_str() + std::strlen(key));
    }
    return -1;
  }
  // The threads serving: all of the process's but its main thread, which
  // only waits for the end of the benchmark.
  long serverThreads() const { return statusField("Threads:") - 1; }
  long peakKiB() const { return statusField("VmHWM:"); }
  long residentKiB() const { return statusField("VmRSS:"); }
  void finish() {
    if (control >= 0) ::close(control);
    int status = 0;
    if (pid > 0) ::waitpid(pid, &status, 0);
    pid = -1;
    control = -1;
  }
};

// Runs `serve` (which must return once serving) in a child; the child exits
// when the parent closes the control pipe.
ServerProcess spawn(const std::function<void()>& serve) {
  // The control ends of the servers already running: a child must not keep
  // them open, or closing them would not tell those servers to exit.
  static std::vector<int> otherControls;
  int ready[2], control[2];
  if (::pipe(ready) != 0 || ::pipe(control) != 0) std::abort();
  pid_t pid = ::fork();
  if (pid == 0) {
    for (int fd : otherControls) ::close(fd);
    ::close(ready[0]);
    ::close(control[1]);
    serve();
    char c = 1;
    if (::write(ready[1], &c, 1) != 1) _exit(2);
    while (::read(control[0], &c, 1) > 0) {
    }
    _exit(0);
  }
  ::close(ready[1]);
  ::close(control[0]);
  char c;
  if (::read(ready[0], &c, 1) != 1) {
    std::fprintf(stderr, "bench_server: a server failed to start\n");
    std::exit(1);
  }
  ::close(ready[0]);
  otherControls.push_back(control[1]);
  return ServerProcess{pid, control[1]};
}

std::string socketPath(const std::string& name) {
  return "/tmp/hsdig-bench-" + name;
}

void serveRawEcho(const std::string& path) {
  ::unlink(path.c_str());
  int listener = ::socket(AF_UNIX, SOCK_STREAM, 0);
  sockaddr_un addr{};
  addr.sun_family = AF_UNIX;
  std::snprintf(addr.sun_path, sizeof addr.sun_path, "%s", path.c_str());
  if (::bind(listener, reinterpret_cast<sockaddr*>(&addr), sizeof addr) != 0 ||
      ::listen(listener, 128) != 0) {
    std::abort();
  }
  std::thread([listener] {
    for (;;) {
      int fd = ::accept(listener, nullptr, nullptr);
      if (fd < 0) return;
      std::thread([fd] {
        char buf[64];
        for (;;) {
          size_t got = 0;
          while (got < sizeof buf) {
            ssize_t n = ::read(fd, buf + got, sizeof buf - got);
            if (n <= 0) {
              ::close(fd);
              return;
            }
            got += static_cast<size_t>(n);
          }
          if (::write(fd, buf, sizeof buf) != sizeof buf) {
            ::close(fd);
            return;
          }
        }
      }).detach();
    }
  }).detach();
}

// Frames of the contract's size on both sides of the stock server.
class ContractFramedFactory : public apache::thrift::transport::TTransportFactory {
 public:
  std::shared_ptr<TTransport> getTransport(std::shared_ptr<TTransport> trans) override {
    return std::make_shared<apache::thrift::transport::TFramedTransport>(
        trans, hsdig::contract::makeTransportConfiguration());
  }
};

void serveStockThreaded(const std::string& path) {
  ::unlink(path.c_str());
  auto server = std::make_shared<apache::thrift::server::TThreadedServer>(
      std::make_shared<hsdig::hsdigEPProcessor>(std::make_shared<BenchHandler>()),
      std::make_shared<apache::thrift::transport::TServerSocket>(path),
      std::make_shared<ContractFramedFactory>(), hsdig::contract::makeProtocolFactory());
  std::thread([server] { server->serve(); }).detach();
  // Serving has started once a connection is accepted.
  for (;;) {
    try {
      apache::thrift::transport::TSocket probe(path);
      probe.open();
      probe.close();
      return;
    } catch (...) {
      std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
  }
}

void serveOurs(const std::string& pipeName) {
  static std::unique_ptr<hsdig::Server> server;  // lives until the child exits
  server = std::make_unique<hsdig::Server>(pipeName, std::make_shared<BenchHandler>());
}

// ---------------------------------------------------------------------------
// Clients

class Caller {
 public:
  virtual ~Caller() = default;
  virtual void call() = 0;                        // one small call
  virtual size_t bigReply(int32_t) { return 0; }  // one reply of that many bytes
};

class RawCaller : public Caller {
 public:
  explicit RawCaller(const std::string& path) {
    fd_ = ::socket(AF_UNIX, SOCK_STREAM, 0);
    sockaddr_un addr{};
    addr.sun_family = AF_UNIX;
    std::snprintf(addr.sun_path, sizeof addr.sun_path, "%s", path.c_str());
    if (::connect(fd_, reinterpret_cast<sockaddr*>(&addr), sizeof addr) != 0) std::abort();
  }
  ~RawCaller() override { ::close(fd_); }
  void call() override {
    char buf[64] = {1};
    if (::write(fd_, buf, sizeof buf) != sizeof buf) std::abort();
    size_t got = 0;
    while (got < sizeof buf) {
      ssize_t n = ::read(fd_, buf + got, sizeof buf - got);
      if (n <= 0) std::abort();
      got += static_cast<size_t>(n);
    }
  }

 private:
  int fd_ = -1;
};

class ThriftCaller : public Caller {
 public:
  // `protocol` reads and writes over `framed`.
  ThriftCaller(std::shared_ptr<TTransport> framed, std::shared_ptr<TProtocol> protocol)
      : framed_(std::move(framed)) {
    client_ = std::make_unique<hsdig::hsdigEPClient>(std::move(protocol));
    framed_->open();
  }
  void call() override {
    hsdig::RetStatus ret;
    client_->reset(ret, 7);
    if (ret.code != 7) std::abort();
  }
  size_t bigReply(int32_t bytes) override {
    hsdig::RetWfmRecords ret;
    client_->omniReadOrFetch(ret, 1, "0", 1.0, bytes, 0, true, false, false);
    return ret.wfmData.size();
  }

 private:
  std::shared_ptr<TTransport> framed_;
  std::unique_ptr<hsdig::hsdigEPClient> client_;
};

struct Target {
  const char* name;
  std::function<std::unique_ptr<Caller>()> connect;
  bool hasBigReplies;
};

struct Figures {
  double medianUs = 0, p99Us = 0;
  double callsPerSecond[3] = {0, 0, 0};
  long threadsAt64 = 0;
  double mibPerSecond16 = 0, mibPerSecond128 = 0;
  long peakMiB = 0, residentAfterMiB = 0;
};

const int kConnections[3] = {1, 8, 64};

// Round trips of one small call from one client, for every server in turn:
// `rounds` turns of n/rounds calls each, so that a drift of the machine (CPU
// placement, other load) spreads evenly over the servers compared.
void measureRoundTrips(const std::vector<const Target*>& targets, std::vector<Figures>& out,
                       bool quick) {
  const int rounds = 20;
  const int perRound = (quick ? 4000 : 40000) / rounds;
  std::vector<std::unique_ptr<Caller>> callers;
  std::vector<std::vector<double>> us(targets.size());
  for (const Target* target : targets) {
    callers.push_back(target->connect());
    for (int i = 0; i < 1000; ++i) callers.back()->call();  // warm-up
  }
  for (int round = 0; round < rounds; ++round) {
    for (size_t t = 0; t < targets.size(); ++t) {
      for (int i = 0; i < perRound; ++i) {
        auto start = Clock::now();
        callers[t]->call();
        us[t].push_back(secondsSince(start) * 1e6);
      }
    }
  }
  for (size_t t = 0; t < targets.size(); ++t) {
    std::sort(us[t].begin(), us[t].end());
    out[t].medianUs = us[t][us[t].size() / 2];
    out[t].p99Us = us[t][us[t].size() * 99 / 100];
  }
}

// Resident memory once the server has finished with the last reply: the
// thread that sent it may still be freeing it while the next call is
// answered, so the lowest of several samples over half a second counts.
long settledResidentKiB(const ServerProcess& process) {
  long lowest = process.residentKiB();
  for (int i = 0; i < 10; ++i) {
    std::this_thread::sleep_for(std::chrono::milliseconds(50));
    lowest = std::min(lowest, process.residentKiB());
  }
  return lowest;
}

// Calls per second, threads at 64 connections, big replies and memory.
// Calls per second at 1, 8 and 64 connections, each server in turn for a
// share of the calls per round, and the server threads at 64 connections.
void measureCallRates(const std::vector<const Target*>& targets,
                      std::vector<ServerProcess>& processes, std::vector<Figures>& out,
                      bool quick) {
  const int rounds = 5;
  for (int k = 0; k < 3; ++k) {
    const int connections = kConnections[k];
    const int perRound = (quick ? 20000 : 100000) / connections / rounds;
    std::vector<std::vector<std::unique_ptr<Caller>>> callers(targets.size());
    for (size_t t = 0; t < targets.size(); ++t) {
      for (int c = 0; c < connections; ++c) callers[t].push_back(targets[t]->connect());
      for (auto& caller : callers[t]) caller->call();
    }
    std::vector<double> seconds(targets.size(), 0.0);
    for (int round = 0; round < rounds; ++round) {
      for (size_t t = 0; t < targets.size(); ++t) {
        std::atomic<int> started{0};
        std::vector<std::thread> threads;
        auto start = Clock::now();
        for (auto& caller : callers[t]) {
          threads.emplace_back([&, c = caller.get()] {
            ++started;
            for (int i = 0; i < perRound; ++i) c->call();
          });
        }
        if (connections == 64 && round == 0) {
          while (started.load() < 64) std::this_thread::yield();
          out[t].threadsAt64 = processes[t].serverThreads();
        }
        for (auto& thread : threads) thread.join();
        seconds[t] += secondsSince(start);
      }
    }
    for (size_t t = 0; t < targets.size(); ++t) {
      out[t].callsPerSecond[k] = double(connections) * perRound * rounds / seconds[t];
    }
  }
}

// Throughput of 16 and 128 MiB replies, the servers taking turns, then each
// server's peak memory and its resident memory once the replies are done.
void measureBigReplies(const std::vector<const Target*>& targets,
                       std::vector<ServerProcess>& processes, std::vector<Figures>& out,
                       bool quick) {
  struct Size {
    int32_t bytes;
    int rounds;
    double Figures::*mibPerSecond;
  };
  const Size sizes[] = {{16 << 20, quick ? 3 : 10, &Figures::mibPerSecond16},
                        {128 << 20, quick ? 2 : 5, &Figures::mibPerSecond128}};
  std::vector<std::unique_ptr<Caller>> callers(targets.size());
  for (size_t t = 0; t < targets.size(); ++t) {
    if (targets[t]->hasBigReplies) callers[t] = targets[t]->connect();
  }
  for (const auto& size : sizes) {
    // One untimed reply first: the first touches of memory new to a process
    // (on a virtual machine, memory new to the guest) cost several times the
    // steady state and vary widely from run to run.
    for (size_t t = 0; t < targets.size(); ++t) {
      if (callers[t] && callers[t]->bigReply(size.bytes) != static_cast<size_t>(size.bytes)) {
        std::abort();
      }
    }
    std::vector<double> seconds(targets.size(), 0.0);
    for (int round = 0; round < size.rounds; ++round) {
      for (size_t t = 0; t < targets.size(); ++t) {
        if (!callers[t]) continue;
        auto start = Clock::now();
        if (callers[t]->bigReply(size.bytes) != static_cast<size_t>(size.bytes)) std::abort();
        seconds[t] += secondsSince(start);
      }
    }
    for (size_t t = 0; t < targets.size(); ++t) {
      if (callers[t]) {
        out[t].*size.mibPerSecond = double(size.bytes) * size.rounds / (1 << 20) / seconds[t];
      }
    }
  }
  for (size_t t = 0; t < targets.size(); ++t) {
    if (!callers[t]) continue;
    out[t].peakMiB = processes[t].peakKiB() / 1024;
    callers[t]->call();  // one small call after the big replies
    out[t].residentAfterMiB = settledResidentKiB(processes[t]) / 1024;
  }
}

void printRow(const char* name, const Figures& f, bool big) {
  std::printf("%-18s %8.1f %8.1f %10.0f %10.0f %10.0f %8ld", name, f.medianUs, f.p99Us,
              f.callsPerSecond[0], f.callsPerSecond[1], f.callsPerSecond[2], f.threadsAt64);
  if (big) {
    std::printf(" %9.0f %9.0f %8ld %8ld\n", f.mibPerSecond16, f.mibPerSecond128, f.peakMiB,
                f.residentAfterMiB);
  } else {
    std::printf(" %9s %9s %8s %8s\n", "-", "-", "-", "-");
  }
}

}  // namespace

int main(int argc, char** argv) {
  hsdig::diagnostics::installSink(&hsdig::diagnostics::discard);
  bool quick = false;
  int only = -1;  // every server
  const char* names[3] = {"raw", "stock", "ours"};
  for (int a = 1; a < argc; ++a) {
    if (std::strcmp(argv[a], "--quick") == 0) {
      quick = true;
    } else if (std::strcmp(argv[a], "--only") == 0 && a + 1 < argc) {
      ++a;
      for (int t = 0; t < 3; ++t) {
        if (std::strcmp(argv[a], names[t]) == 0) only = t;
      }
      if (only < 0) {
        std::fprintf(stderr, "bench_server: unknown server '%s' (raw, stock, ours)\n", argv[a]);
        return 2;
      }
    } else {
      const bool help = std::strcmp(argv[a], "--help") == 0;
      if (!help) std::fprintf(stderr, "bench_server: unknown argument '%s'\n", argv[a]);
      std::fprintf(help ? stdout : stderr,
                   "usage: bench_server [--quick] [--only raw|stock|ours]\n"
                   "  Prints round trips, calls per second, server threads, reply\n"
                   "  throughput and server memory, then the ratios of our server.\n"
                   "  --only measures one server and prints its row alone (for profiling).\n");
      return help ? 0 : 2;
    }
  }
  const std::string tag = std::to_string(::getpid());
  const std::string rawPath = socketPath("raw-" + tag);
  const std::string stockPath = socketPath("stock-" + tag);
  const std::string ourName = hsdig::transport::pipeNameForResource("bench-server-" + tag);
  auto config = hsdig::contract::makeTransportConfiguration();

  Target raw{"raw socket", [&] { return std::make_unique<RawCaller>(rawPath); }, false};
  Target stock{
      "TThreadedServer",
      [&] {
        auto socket = std::make_shared<apache::thrift::transport::TSocket>(stockPath, config);
        auto framed = std::make_shared<apache::thrift::transport::TFramedTransport>(socket, config);
        return std::make_unique<ThriftCaller>(
            framed, hsdig::contract::makeProtocolFactory()->getProtocol(framed));
      },
      true};
  Target ours{"hsdig Server",
              [&] {
                auto pipe = std::make_shared<hsdig::transport::TPipe>(ourName);
                auto framed = hsdig::transport::makeFramedTransport(pipe);
                return std::make_unique<ThriftCaller>(
                    framed, std::make_shared<hsdig::contract::TBulkStringBinaryProtocol>(framed));
              },
              true};

  std::printf("%-18s %8s %8s %10s %10s %10s %8s %9s %9s %8s %8s\n", "server", "rtt50us", "rtt99us",
              "calls/s@1", "calls/s@8", "calls/s@64", "thr@64", "MiB/s16M", "MiB/s128M", "peakMiB",
              "afterMiB");
  Figures results[3];
  const Target* targets[3] = {&raw, &stock, &ours};
  const std::function<void()> serves[3] = {[&] { serveRawEcho(rawPath); },
                                           [&] { serveStockThreaded(stockPath); },
                                           [&] { serveOurs(ourName); }};
  std::vector<int> chosen;
  for (int t = 0; t < 3; ++t) {
    if (only < 0 || t == only) chosen.push_back(t);
  }
  std::vector<ServerProcess> processes;
  std::vector<const Target*> chosenTargets;
  for (int t : chosen) {
    processes.push_back(spawn(serves[t]));
    chosenTargets.push_back(targets[t]);
  }
  std::vector<Figures> figures(chosen.size());
  // Every server runs for the whole measurement, and each phase gives them
  // turns, so a drift of the machine weighs on all of them alike.
  measureRoundTrips(chosenTargets, figures, quick);
  measureCallRates(chosenTargets, processes, figures, quick);
  measureBigReplies(chosenTargets, processes, figures, quick);
  for (size_t c = 0; c < chosen.size(); ++c) {
    processes[c].finish();
    results[chosen[c]] = figures[c];
    printRow(chosenTargets[c]->name, figures[c], chosenTargets[c]->hasBigReplies);
  }
  ::unlink(rawPath.c_str());
  ::unlink(stockPath.c_str());
  if (only >= 0) return 0;

  const Figures& r = results[0];
  const Figures& s = results[1];
  const Figures& o = results[2];
  std::printf("\nratios of hsdig Server\n");
  std::printf("  round trip (median) / raw socket       %6.2f  (target <= 1.30)\n",
              o.medianUs / r.medianUs);
  std::printf("  round trip (median) / TThreadedServer  %6.2f\n", o.medianUs / s.medianUs);
  for (int k = 0; k < 3; ++k) {
    std::printf("  calls/s at %2d / TThreadedServer        %6.2f%s\n", kConnections[k],
                o.callsPerSecond[k] / s.callsPerSecond[k], k == 2 ? "  (target >= 1.00)" : "");
  }
  std::printf("  server threads at 64 connections       %6ld  (target <= 8; stock %ld)\n",
              o.threadsAt64, s.threadsAt64);
  std::printf("  128 MiB reply throughput / stock       %6.2f  (target >= 1.50)\n",
              o.mibPerSecond128 / s.mibPerSecond128);
  std::printf("  16 MiB reply throughput / stock        %6.2f\n",
              o.mibPerSecond16 / s.mibPerSecond16);
  std::printf("  peak memory / stock                    %6.2f  (target <= 1.00)\n",
              double(o.peakMiB) / double(s.peakMiB));
  std::printf("  resident after the big replies         %6ld MiB  (target < 32; stock %ld)\n",
              o.residentAfterMiB, s.residentAfterMiB);
  return 0;
}
