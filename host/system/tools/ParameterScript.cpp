#include "orbane/ParameterScript.h"

#include "orbane/ClassIDs.h"
#include "orbane/ImageFile.h"
#include "orbane/ImageParam.h"
#include "orbane/Number.h"
#include "orbane/OrbIDParam.h"
#include "orbane/Point.h"
#include "orbane/PolyLine.h"
#include "orbane/PolyLineScript.h"
#include "orbane/ScriptVal.h"
#include "orbane/ScriptValParam.h"
#include "orbane/Text.h"

#include <QFileInfo>

#include <cmath>

namespace Orbane {

namespace {

// Reads a point's coordinate from {x, y, z} or {X=, Y=, Z=}.
bool Coord(const ScriptVal &v, int index, const char *name, float64 def, float64 &out)
{
    const ScriptVal *c = v.FindKeyConst(ScriptVal(index));
    if (!c)
        c = v.FindKeyConst(ScriptVal(name));
    if (!c) {
        out = def;
        return true;
    }
    out = c->GetNumber();
    return c->IsNumber();
}

Parameter *MakePoint(const ScriptVal &v)
{
    float64 x, y, z;
    if (!v.IsTable() || !Coord(v, 1, "X", 0.0, x) || !Coord(v, 2, "Y", 0.0, y) || !Coord(v, 3, "Z", 0.0, z))
        return nullptr;
    return new Point(x, y, z);
}

Parameter *Make(const OrbID &type, const ScriptVal &v)
{
    if (type == CLSID_DataType_Number)
        return v.IsNumber() ? new Number(v.GetNumber()) : v.IsBool() ? new Number(v.GetBool() ? 1.0 : 0.0) : nullptr;
    if (type == CLSID_DataType_Point)
        return MakePoint(v);
    if (type == CLSID_DataType_Text)
        return v.IsString() ? new Text(v.GetString()) : nullptr;
    if (type == CLSID_DataType_ID)
        return v.IsString() ? new OrbIDParam(v.GetString()) : nullptr;
    if (type == CLSID_DataType_ScriptVal)
        return new ScriptValParam(ScriptValParam::DeepCopy(v));
    if (type == CLSID_DataType_Image)
        return v.IsString() ? new ImageParam(v.GetString()) : nullptr;
    return nullptr;
}

bool FiniteAt(const ScriptVal &v, int depth)
{
    if (v.IsNumber())
        return std::isfinite(v.GetNumber());
    // Values of Inputs are a few levels deep; a table that holds itself ends here.
    if (!v.IsTable() || depth > 16)
        return true;
    for (const ScriptVal::Entry &e : v.GetEntries())
        if (!FiniteAt(e.second, depth + 1))
            return false;
    return true;
}

bool IsShape(const OrbID &type)
{
    return type == CLSID_DataType_Polyline || type == CLSID_DataType_BSplinePolyline;
}

} // namespace

Parameter *ParameterScript::FromScript(const OrbID &dataType, const ScriptVal &value, std::string *error)
{
    // A shape says itself what is wrong with it (which point, which field).
    if (IsShape(dataType))
        return PolyLineScript::FromScript(dataType, value, error);
    // An image file that is there but corrupt or too large is refused with
    // its reason before it is decoded; a file not there yet keeps its path.
    QString why;
    const QString image = dataType == CLSID_DataType_Image ? QString::fromUtf8(value.GetString()) : QString();
    if (!image.isEmpty() && QFileInfo::exists(image) && !ImageFile::Check(image, &why)) {
        if (error)
            *error = why.toStdString();
        return nullptr;
    }
    if (Parameter *p = Make(dataType, value))
        return p;
    if (error)
        *error = std::string("expected a value of type ") + dataType.c_str() + ", got " + value.TypeName();
    return nullptr;
}

bool ParameterScript::IsFinite(const ScriptVal &value)
{
    return FiniteAt(value, 0);
}

ScriptVal ParameterScript::ToScript(const Parameter *value)
{
    if (auto n = dynamic_cast<const Number *>(value))
        return ScriptVal(n->Value);
    if (auto p = dynamic_cast<const Point *>(value)) {
        ScriptVal t = ScriptVal::NewTable();
        t.Append(p->X);
        t.Append(p->Y);
        t.Append(p->Z);
        return t;
    }
    if (auto t = dynamic_cast<const Text *>(value))
        return ScriptVal(t->Value);
    if (auto id = dynamic_cast<const OrbIDParam *>(value))
        return ScriptVal(id->Value.c_str());
    if (auto s = dynamic_cast<const ScriptValParam *>(value))
        return ScriptValParam::DeepCopy(s->Value);
    if (auto shape = dynamic_cast<const PolyLine *>(value))
        return PolyLineScript::ToScript(*shape);
    if (auto i = dynamic_cast<const ImageParam *>(value))
        return ScriptVal(i->Path.c_str());
    return ScriptVal();
}

} // namespace Orbane
