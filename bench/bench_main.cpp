// Benchmark main: runs every benchmark, then prints the time ratio of each
// pair BM_<case>_duduzu / BM_<case>_peer (below 1 means the library is faster).
#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstring>
#include <map>
#include <string>

namespace {

class RatioReporter : public benchmark::ConsoleReporter {
 public:
  void ReportRuns(const std::vector<Run>& runs) override {
    ConsoleReporter::ReportRuns(runs);
    for (const Run& run : runs) {
      bool median = run.run_type == Run::RT_Aggregate && run.aggregate_name == "median";
      if (run.run_type == Run::RT_Aggregate && !median) continue;
      std::string name = run.benchmark_name();
      if (median) name = name.substr(0, name.rfind('_'));  // drop "_median"
      record(name, run.GetAdjustedRealTime(), median);
    }
  }

  void Finalize() override {
    ConsoleReporter::Finalize();
    printf("\n%-52s %12s %12s %8s\n", "case", "duduzu", "peer", "ratio");
    for (const auto& [key, t] : times_)
      if (t.ours > 0 && t.peer > 0)
        printf("%-52s %12.1f %12.1f %8.2f\n", key.c_str(), t.ours, t.peer, t.ours / t.peer);
  }

 private:
  struct Pair {
    double ours = 0, peer = 0;
    bool fromMedian = false;
  };

  void record(const std::string& name, double time, bool median) {
    for (const char* side : {"_duduzu", "_peer"}) {
      size_t at = name.find(side);
      if (at == std::string::npos) continue;
      std::string key = name.substr(0, at) + name.substr(at + strlen(side));
      Pair& p = times_[key];
      if (p.fromMedian && !median) return;  // a median beats single runs
      p.fromMedian = median;
      (side[1] == 'd' ? p.ours : p.peer) = time;
    }
  }

  std::map<std::string, Pair> times_;
};

}  // namespace

int main(int argc, char** argv) {
  benchmark::Initialize(&argc, argv);
  if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
  RatioReporter reporter;
  benchmark::RunSpecifiedBenchmarks(&reporter);
  benchmark::Shutdown();
  return 0;
}
