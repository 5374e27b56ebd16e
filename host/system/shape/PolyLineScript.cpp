#include "orbane/PolyLineScript.h"

#include "orbane/AutoRef.h"
#include "orbane/BSplinePolyLine.h"
#include "orbane/ClassIDs.h"
#include "orbane/ScriptVal.h"

#include <cmath>

namespace Orbane {

namespace {

// The numeric fields of a point table and where each lands.
struct Field
{
    const char *name;
    float64 PolyPoint::*member;
};

constexpr Field kFields[] = {
    {"inX", &PolyPoint::InX},           {"inY", &PolyPoint::InY},           {"outX", &PolyPoint::OutX},
    {"outY", &PolyPoint::OutY},         {"weight", &PolyPoint::Weight},     {"time", &PolyPoint::Time},
    {"pressure", &PolyPoint::Pressure}, {"height", &PolyPoint::Height},     {"angleXY", &PolyPoint::AngleXY},
    {"angleZ", &PolyPoint::AngleZ},     {"rotation", &PolyPoint::Rotation},
};

struct FlagField
{
    const char *name;
    uint32 flag;
};

constexpr FlagField kFlags[] = {{"linear", PPF_Linear},
                                {"tagged", PPF_Tagged},
                                {"published", PPF_Published},
                                {"following", PPF_Following},
                                {"gap", PPF_Discontinual},
                                {"locked", PPF_Locked}};

// Whole-number fields.
struct IntField
{
    const char *name;
    int32 PolyPoint::*member;
    int32 def;
};

constexpr IntField kInts[] = {{"id", &PolyPoint::TagID, 0}, {"follows", &PolyPoint::FollowIndex, -1}};

bool Fail(std::string *error, int32 index, const std::string &why)
{
    if (error)
        *error = "point " + std::to_string(index) + ": " + why;
    return false;
}

// Reads a finite number at `key`; absent leaves `out` as it is.
bool ReadNumber(const ScriptVal &t, const char *key, float64 &out, int32 index, std::string *error)
{
    const ScriptVal *v = t.FindKeyConst(ScriptVal(key));
    if (!v)
        return true;
    if (!v->IsNumber() || !std::isfinite(v->GetNumber()))
        return Fail(error, index, std::string(key) + " must be a finite number");
    out = v->GetNumber();
    return true;
}

bool ReadPoint(const ScriptVal &t, int32 index, PolyPoint &p, std::string *error)
{
    if (!t.IsTable())
        return Fail(error, index, "expected a table");
    if (!t.FindKeyConst(ScriptVal("x")) || !t.FindKeyConst(ScriptVal("y")))
        return Fail(error, index, "needs x and y");
    float64 x = 0.0, y = 0.0;
    if (!ReadNumber(t, "x", x, index, error) || !ReadNumber(t, "y", y, index, error))
        return false;
    p = PolyPoint(x, y);
    for (const Field &f : kFields)
        if (!ReadNumber(t, f.name, p.*f.member, index, error))
            return false;
    if (p.Weight <= 0.0)
        return Fail(error, index, "weight must be above 0");
    for (const FlagField &f : kFlags)
        if (const ScriptVal *v = t.FindKeyConst(ScriptVal(f.name)); v && v->GetBool())
            p.Flags |= f.flag;
    for (const IntField &f : kInts) {
        float64 v = f.def;
        if (!ReadNumber(t, f.name, v, index, error))
            return false;
        p.*f.member = int32(v);
    }
    return true;
}

ScriptVal WritePoint(const PolyPoint &p)
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey("x", p.X);
    t.SetKey("y", p.Y);
    const PolyPoint defaults(p.X, p.Y);
    for (const Field &f : kFields) {
        const bool handle = f.member == &PolyPoint::InX || f.member == &PolyPoint::InY ||
                            f.member == &PolyPoint::OutX || f.member == &PolyPoint::OutY;
        // Handles always, so a script can read them without knowing the
        // default; the extras only where they say something.
        if (handle || p.*f.member != defaults.*f.member)
            t.SetKey(f.name, p.*f.member);
    }
    for (const FlagField &f : kFlags)
        if (p.Flags & f.flag)
            t.SetKey(f.name, true);
    for (const IntField &f : kInts)
        if (p.*f.member != f.def)
            t.SetKey(f.name, int64(p.*f.member));
    return t;
}

} // namespace

PolyLine *PolyLineScript::FromScript(const OrbID &dataType, const ScriptVal &value, std::string *error)
{
    const bool bspline = dataType == CLSID_DataType_BSplinePolyline;
    if (!value.IsTable()) {
        if (error)
            *error = std::string("expected a shape table, got ") + value.TypeName();
        return nullptr;
    }
    if (const ScriptVal *kind = value.FindKeyConst(ScriptVal("kind"))) {
        const std::string want = bspline ? "bspline" : "bezier";
        if (want != kind->GetString()) {
            if (error)
                *error = std::string("kind \"") + kind->GetString("?") + "\" does not suit " + dataType.c_str();
            return nullptr;
        }
    }
    AutoRef<PolyLine> shape(bspline ? new BSplinePolyLine : new PolyLine);
    const ScriptVal *points = value.FindKeyConst(ScriptVal("points"));
    for (int32 i = 1; points && i <= points->Length(); ++i) {
        PolyPoint p;
        if (!ReadPoint(*points->FindKeyConst(ScriptVal(i)), i, p, error))
            return nullptr;
        shape->AddPoint(p);
    }
    if (const ScriptVal *closed = value.FindKeyConst(ScriptVal("closed")); closed && closed->GetBool())
        shape->Close();
    return shape.Take();
}

ScriptVal PolyLineScript::ToScript(const PolyLine &shape)
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey("kind", shape.DataType() == CLSID_DataType_BSplinePolyline ? "bspline" : "bezier");
    t.SetKey("closed", shape.IsClosed());
    ScriptVal points = ScriptVal::NewTable();
    for (const PolyPoint &p : shape.Points())
        points.Append(WritePoint(p));
    t.SetKey("points", points);
    return t;
}

} // namespace Orbane
