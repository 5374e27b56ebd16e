#include "CompInputs.h"

#include "orbane/AutoRef.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/Parameter.h"
#include "orbane/ParameterScript.h"
#include "orbane/ScriptVal.h"

#include <QDir>

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

namespace Orbane {

namespace {

// Expression hook: the text of a live expression kept on the Input. Inputs
// keep none yet, so there is nothing to write.
std::string ExpressionOf(const Input &)
{
    return std::string();
}

// Expression hook: gives the Input its expression back. Until Inputs keep
// expressions, a comp that has one is refused rather than losing it quietly.
bool RestoreExpression(Input &in, const std::string &expression, std::string *error)
{
    if (expression.empty())
        return true;
    *error = std::string("Input \"") + in.GetID().c_str() + "\": this build keeps no expressions";
    return false;
}

const char *ModeName(Interpolation mode)
{
    return mode == Interpolation::Smooth ? "smooth" : "linear";
}

// Image paths relative to the comp, so a comp moves with its folder.
ScriptVal ValueOut(const Input &in, const Parameter *value, const QDir &base)
{
    ScriptVal v = ParameterScript::ToScript(value);
    if (in.GetDataType() == CLSID_DataType_Image && v.IsString() && *v.GetString())
        v = ScriptVal(CompInputs::PathFrom(base, v.GetString()));
    return v;
}

ScriptVal SaveInput(const Input &in, const QDir &base)
{
    ScriptVal state = ScriptVal::NewTable();
    if (in.IsAnimated()) {
        if (in.GetInterpolation() != Interpolation::Linear)
            state.SetKey("interpolation", ModeName(in.GetInterpolation()));
        ScriptVal keys = ScriptVal::NewTable();
        for (const float64 time : in.KeyTimes()) {
            const AutoRef<Parameter> value(in.GetKey(time));
            ScriptVal key = ScriptVal::NewTable();
            key.Append(time);
            key.Append(ValueOut(in, value.get(), base));
            keys.Append(key);
        }
        state.SetKey("keys", keys);
    } else if (const AutoRef<Parameter> value(in.GetValue(0.0)); value) {
        state.SetKey("value", ValueOut(in, value.get(), base));
    }
    const std::string expression = ExpressionOf(in);
    if (!expression.empty())
        state.SetKey("expression", expression);
    return state;
}

// What one Input is to become, read and checked in full before it is applied.
struct InputPlan
{
    Input *in = nullptr;
    AutoRef<Parameter> value;
    bool animated = false;
    std::vector<std::pair<float64, AutoRef<Parameter>>> keys;
    Interpolation mode = Interpolation::Linear;
    std::string expression;
};

class Reader
{
public:
    Reader(const QDir &base, std::string *error) : mBase(base), mError(error) {}

    bool Read(Operator &tool, const ScriptVal &id, const ScriptVal &state, InputPlan &plan);

private:
    bool ReadValue(const ScriptVal &v, const std::string &where, AutoRef<Parameter> &out);
    bool ReadKeys(const ScriptVal &keys);
    bool Fail(const std::string &why)
    {
        *mError = "Input \"" + mID + "\": " + why;
        return false;
    }

    QDir mBase;
    std::string *mError;
    std::string mID;
    InputPlan *mPlan = nullptr;
};

bool Reader::Read(Operator &tool, const ScriptVal &id, const ScriptVal &state, InputPlan &plan)
{
    mPlan = &plan;
    mID = id.GetString("?");
    if (!id.IsString() || !state.IsTable())
        return Fail("the state of an Input is a table under the Input's id");
    plan.in = tool.FindInput(OrbID(id.GetString()));
    if (!plan.in)
        return Fail(std::string("tool \"") + tool.GetName() + "\" has no such Input (was its tool file changed?)");
    if (const ScriptVal *v = state.FindKeyConst(ScriptVal("value")); v && !ReadValue(*v, "value", plan.value))
        return false;
    if (const ScriptVal *keys = state.FindKeyConst(ScriptVal("keys")); keys && !ReadKeys(*keys))
        return false;
    if (const ScriptVal *mode = state.FindKeyConst(ScriptVal("interpolation"))) {
        const std::string name = mode->GetString("?");
        if (name != "linear" && name != "smooth")
            return Fail("interpolation is \"linear\" or \"smooth\", not \"" + name + "\"");
        plan.mode = name == "smooth" ? Interpolation::Smooth : Interpolation::Linear;
    }
    if (const ScriptVal *e = state.FindKeyConst(ScriptVal("expression"))) {
        if (!e->IsString())
            return Fail("expression must be a text");
        plan.expression = e->GetString();
    }
    return true;
}

bool Reader::ReadValue(const ScriptVal &v, const std::string &where, AutoRef<Parameter> &out)
{
    const OrbID &type = mPlan->in->GetDataType();
    if (type != CLSID_DataType_ScriptVal && !ParameterScript::IsFinite(v))
        return Fail(where + " holds a number that is not finite");
    ScriptVal value = v;
    if (type == CLSID_DataType_Image && v.IsString() && *v.GetString())
        value = ScriptVal(mBase.filePath(QString::fromUtf8(v.GetString())).toStdString());
    std::string why;
    out.Reset(ParameterScript::FromScript(type, value, &why));
    return out || Fail(where + ": " + why);
}

bool Reader::ReadKeys(const ScriptVal &keys)
{
    if (!keys.IsTable())
        return Fail("keys must be a list of { time, value }");
    mPlan->animated = true;
    for (int32 i = 1; i <= keys.Length(); ++i) {
        const ScriptVal &key = *keys.FindKeyConst(ScriptVal(i));
        const ScriptVal *time = key.FindKeyConst(ScriptVal(1));
        const ScriptVal *value = key.FindKeyConst(ScriptVal(2));
        const std::string where = "key " + std::to_string(i);
        if (!time || !value)
            return Fail(where + " must be { time, value }");
        const float64 t = time->GetNumber(NAN);
        if (!std::isfinite(t) || t <= TIME_UNDEFINED)
            return Fail(where + " is not at a finite time");
        AutoRef<Parameter> param;
        if (!ReadValue(*value, where, param))
            return false;
        mPlan->keys.emplace_back(t, std::move(param));
    }
    return true;
}

// The tool is in no document: these writes record nothing and tell no one.
bool Apply(InputPlan &plan, std::string *error)
{
    Input &in = *plan.in;
    if (plan.value)
        in.SetValue(plan.value.get(), 0.0, SETVALUE_NoUndo);
    if (plan.animated) {
        // Switching on makes a key of the plain value at time 0; it stays
        // only if the comp has one there.
        in.SetAnimated(true);
        const std::vector<float64> made = in.KeyTimes();
        for (auto &[time, value] : plan.keys)
            in.SetValue(value.get(), time, SETVALUE_NoUndo);
        for (const float64 time : made)
            if (std::none_of(plan.keys.begin(), plan.keys.end(), [time](const auto &k) { return k.first == time; }))
                in.RemoveKey(time, SETVALUE_NoUndo);
    }
    in.SetInterpolation(plan.mode);
    return RestoreExpression(in, plan.expression, error);
}

} // namespace

std::string CompInputs::PathFrom(const QDir &base, const std::string &file)
{
    const QString absolute = base.absoluteFilePath(QString::fromStdString(file));
    const QString top = base.absolutePath().section('/', 1, 1);
    if (top.isEmpty() || absolute.section('/', 1, 1) != top)
        return absolute.toStdString();
    return base.relativeFilePath(absolute).toStdString();
}

ScriptVal CompInputs::Save(const Operator &tool, const QDir &base)
{
    ScriptVal out = ScriptVal::NewTable();
    for (const Input *in : tool.Inputs())
        out.SetKey(ScriptVal(in->GetID().c_str()), SaveInput(*in, base));
    return out;
}

bool CompInputs::Restore(Operator &tool, const ScriptVal &inputs, const QDir &base, std::string *error)
{
    if (!inputs.IsTable()) {
        *error = std::string("tool \"") + tool.GetName() + "\": inputs must be a table";
        return false;
    }
    std::vector<InputPlan> plans(inputs.GetEntries().size());
    Reader reader(base, error);
    for (std::size_t i = 0; i < plans.size(); ++i) {
        const ScriptVal::Entry &e = inputs.GetEntries()[i];
        if (!reader.Read(tool, e.first, e.second, plans[i]))
            return false;
    }
    for (InputPlan &plan : plans)
        if (!Apply(plan, error))
            return false;
    return true;
}

} // namespace Orbane
