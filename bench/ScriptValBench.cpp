// Script tables with many entries: filling a table key by key and finding
// every key again, against a plain std::unordered_map of the same strings.
// A walk over the entries per lookup (as tables once did) would grow with
// the square of the count and leave the plain map a thousand times behind.
#include "orbane/ScriptVal.h"

#include <benchmark/benchmark.h>

#include <string>
#include <unordered_map>
#include <vector>

namespace {

using Orbane::ScriptVal;

std::vector<std::string> Names(int64_t count)
{
    std::vector<std::string> names;
    for (int64_t i = 0; i < count; ++i)
        names.push_back("item" + std::to_string(i));
    return names;
}

void BM_ScriptVal_FillAndFind(benchmark::State &state)
{
    std::vector<ScriptVal> keys;
    for (const std::string &name : Names(state.range(0)))
        keys.emplace_back(name.c_str());
    for (auto _ : state) {
        ScriptVal table = ScriptVal::NewTable();
        for (const ScriptVal &key : keys)
            table.SetKey(key, ScriptVal(1.0));
        for (const ScriptVal &key : keys)
            benchmark::DoNotOptimize(table.FindKeyConst(key));
    }
}
BENCHMARK(BM_ScriptVal_FillAndFind)->Arg(50000)->Unit(benchmark::kMillisecond);

void BM_StdMap_FillAndFind(benchmark::State &state)
{
    const std::vector<std::string> keys = Names(state.range(0));
    for (auto _ : state) {
        std::unordered_map<std::string, double> table;
        for (const std::string &key : keys)
            table[key] = 1.0;
        for (const std::string &key : keys)
            benchmark::DoNotOptimize(table.find(key));
    }
}
BENCHMARK(BM_StdMap_FillAndFind)->Arg(50000)->Unit(benchmark::kMillisecond);

} // namespace
