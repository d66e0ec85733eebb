#include "bench/bench_report.h"

void benchLoad(BenchReport&) {}
