// A time change that re-evaluates 1000 live expressions, each reading the
// time and an Input of another tool, in dependency order, each result stored
// and its watchers told. Against the plain alternative: the same 1000 values
// computed in C++ and written with Input::SetValue, one call each.
#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <benchmark/benchmark.h>

#include <string>
#include <vector>

using namespace Orbane;

namespace {

// A document with a "Source1" tool (Gain) and a "Grid1" tool of `count`
// number Inputs.
struct Scene
{
    explicit Scene(int count)
    {
        AutoRef<Operator> source(new Operator("Source1", "Tool"));
        source->AddInput("Gain", "Gain", CLSID_DataType_Number, {}, AutoNumber(0.5));
        AutoRef<Operator> grid(new Operator("Grid1", "Tool"));
        for (int i = 0; i < count; ++i) {
            const std::string id = "N" + std::to_string(i);
            inputs.push_back(grid->AddInput(id.c_str(), id.c_str(), CLSID_DataType_Number, {}, AutoNumber(0.0)));
        }
        doc.AddTool(source);
        doc.AddTool(grid);
    }

    OrbaneDoc doc;
    std::vector<Input *> inputs;
};

void BM_Expressions_TimeChange(benchmark::State &state)
{
    Scene scene(int(state.range(0)));
    for (std::size_t i = 0; i < scene.inputs.size(); ++i)
        scene.inputs[i]->SetExpression(("time * Source1.Gain + " + std::to_string(i)).c_str(), SETVALUE_NoUndo);
    float64 time = 0.0;
    for (auto _ : state)
        scene.doc.SetCurrentTime(time += 1.0);
}
BENCHMARK(BM_Expressions_TimeChange)->Arg(1000)->Unit(benchmark::kMicrosecond);

void BM_PlainSetValue_TimeChange(benchmark::State &state)
{
    Scene scene(int(state.range(0)));
    const Input *gain = scene.doc.FindTool("Source1")->FindInput("Gain");
    float64 time = 0.0;
    for (auto _ : state) {
        time += 1.0;
        const AutoNumber g(const_cast<Input *>(gain), time);
        for (std::size_t i = 0; i < scene.inputs.size(); ++i)
            scene.inputs[i]->SetValue(AutoNumber(time * g->Value + float64(i)), time, SETVALUE_NoUndo);
    }
}
BENCHMARK(BM_PlainSetValue_TimeChange)->Arg(1000)->Unit(benchmark::kMicrosecond);

} // namespace
