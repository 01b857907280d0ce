// SafeRational's guarded operators against plain boost::rational on the same operands.
#include <VelaMediaLib/time/rational/SafeRational.h>

#include <benchmark/benchmark.h>
#include <random>
#include <vector>

using VelaMediaLib::SafeRational;

namespace {

const size_t kOperands = 1024;

template <typename T>
std::vector<T> operands() {
    std::mt19937_64 random(42);
    std::uniform_int_distribution<long long> num(-100000, 100000), den(1, 30000);
    std::vector<T> values;
    for (size_t i = 0; i < kOperands; ++i) {
        long long n = num(random);
        values.push_back(T(n == 0 ? 1 : n, den(random)));
    }
    return values;
}

template <typename T, typename Op>
void run(benchmark::State& state, Op op) {
    const std::vector<T> values = operands<T>();
    size_t i = 0;
    for (auto _ : state) {
        benchmark::DoNotOptimize(op(values[i], values[(i + 1) % kOperands]));
        i = (i + 1) % kOperands;
    }
}

typedef boost::rational<long long> Boost;

void BM_Add_Boost(benchmark::State& s) {
    run<Boost>(s, [](const Boost& a, const Boost& b) { return a + b; });
}
void BM_Add_Safe(benchmark::State& s) {
    run<SafeRational>(s, [](const SafeRational& a, const SafeRational& b) { return a + b; });
}
void BM_Mul_Boost(benchmark::State& s) {
    run<Boost>(s, [](const Boost& a, const Boost& b) { return a * b; });
}
void BM_Mul_Safe(benchmark::State& s) {
    run<SafeRational>(s, [](const SafeRational& a, const SafeRational& b) { return a * b; });
}
void BM_Div_Boost(benchmark::State& s) {
    run<Boost>(s, [](const Boost& a, const Boost& b) { return a / b; });
}
void BM_Div_Safe(benchmark::State& s) {
    run<SafeRational>(s, [](const SafeRational& a, const SafeRational& b) { return a / b; });
}

} // namespace

BENCHMARK(BM_Add_Boost);
BENCHMARK(BM_Add_Safe);
BENCHMARK(BM_Mul_Boost);
BENCHMARK(BM_Mul_Safe);
BENCHMARK(BM_Div_Boost);
BENCHMARK(BM_Div_Safe);
