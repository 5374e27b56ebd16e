// Script tables with many entries: filling a table key by key and finding
// every key again. With the table's hash index both grow linearly with the
// entry count; a walk over the entries per lookup would grow with its square.
#include "orbane/ScriptVal.h"

#include <benchmark/benchmark.h>

#include <string>
#include <vector>

namespace {

using Orbane::ScriptVal;

void BM_ScriptVal_FillAndFind(benchmark::State &state)
{
    std::vector<ScriptVal> keys;
    for (int64_t i = 0; i < state.range(0); ++i)
        keys.emplace_back(("item" + std::to_string(i)).c_str());
    for (auto _ : state) {
        ScriptVal table = ScriptVal::NewTable();
        for (const ScriptVal &key : keys)
            table.SetKey(key, ScriptVal(1.0));
        for (const ScriptVal &key : keys)
            benchmark::DoNotOptimize(table.FindKeyConst(key));
    }
}
BENCHMARK(BM_ScriptVal_FillAndFind)->Arg(500)->Arg(50000)->Unit(benchmark::kMillisecond);

} // namespace
