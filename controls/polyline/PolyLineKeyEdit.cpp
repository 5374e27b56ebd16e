#include "polyline/PolyLineKeyEdit.h"

#include "polyline/PolyLineAnimation.h"
#include "polyline/PolyLineControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Number.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/PolyLine.h"

#include <algorithm>
#include <string>

namespace Orbane {

bool PolyLineKeyEdit::Refuse(const char *why)
{
    mControl.Tell(why);
    return false;
}

std::vector<uint8> PolyLineKeyEdit::Points(int32 count) const
{
    const SelMask &sel = mControl.Selection();
    std::vector<uint8> bytes(std::size_t(std::max(count, 0)), 1);
    if (sel.GetSetCount() > 0 && sel.GetCount() == count)
        for (int32 i = 0; i < count; ++i)
            bytes[std::size_t(i)] = sel[i] ? 1 : 0;
    return bytes;
}

bool PolyLineKeyEdit::Gather(const char *what, std::vector<float64> &times, std::vector<AutoRef<PolyLine>> &shapes)
{
    if (!mControl.Editor().CanEdit())
        return false;
    Input *main = mControl.GetMainInput();
    if (!main->IsAnimated())
        return Refuse((std::string(what) + ": the shape is not animated").c_str());
    times = main->KeyTimes();
    if (times.size() < 3)
        return Refuse((std::string(what) + ": it needs three keyframes or more (the first and last stay)").c_str());
    for (const float64 t : times) {
        AutoRef<PolyLine> key(static_cast<PolyLine *>(main->GetKey(t)));
        if (!key || key->GetCount() != mControl.Shape()->GetCount())
            return Refuse((std::string(what) + ": the keyframes have different points").c_str());
        shapes.emplace_back(static_cast<PolyLine *>(key->Clone()));
    }
    return true;
}

bool PolyLineKeyEdit::WriteKeys(const char *undo, const std::vector<float64> &times,
                                const std::vector<AutoRef<PolyLine>> &shapes)
{
    mControl.OpenStep(undo);
    bool written = false;
    for (std::size_t i = 0; i < times.size(); ++i)
        written = mControl.SetInputs(shapes[i].get(), times[i], 0, nullptr) || written;
    mControl.CloseStep();
    mControl.Redraw();
    return written || Refuse("The keyframes did not take the edit");
}

bool PolyLineKeyEdit::SmoothAnimation(float64 amount, int32 passes)
{
    std::vector<float64> times;
    std::vector<AutoRef<PolyLine>> shapes;
    if (!Gather("Smooth Animation", times, shapes))
        return false;
    const std::vector<uint8> points = Points(shapes.front()->GetCount());
    if (!PolyLineAnimation::SmoothKeys(shapes, times, points.data(), amount, passes))
        return Refuse("Smooth Animation: the motion is smooth already");
    return WriteKeys("Smooth Animation", times, shapes);
}

bool PolyLineKeyEdit::EaseInOut(float64 in, float64 out)
{
    std::vector<float64> times;
    std::vector<AutoRef<PolyLine>> shapes;
    if (!Gather("Ease In / Out", times, shapes))
        return false;
    Input *main = mControl.GetMainInput();
    const std::vector<uint8> points = Points(shapes.front()->GetCount());
    const float64 first = times.front(), span = times.back() - first;
    bool changed = false;
    // Every inner key is read from the motion as it was, before any moves.
    for (std::size_t i = 1; i + 1 < times.size(); ++i) {
        const float64 eased = first + span * PolyLineAnimation::Ease((times[i] - first) / span, in, out);
        const AutoParam<PolyLine> there(main, eased);
        changed = (there && PolyLineAnimation::CopyPoints(*shapes[i], *there, points.data())) || changed;
    }
    if (!changed)
        return Refuse("Ease In / Out: the motion is eased so already");
    return WriteKeys("Ease In / Out", times, shapes);
}

bool PolyLineKeyEdit::DeleteKeys(const std::vector<float64> &times)
{
    if (!mControl.Editor().CanEdit())
        return false;
    Input *main = mControl.GetMainInput();
    if (!main->IsAnimated())
        return Refuse("Delete Keyframes: the shape is not animated");
    if (times.empty())
        return Refuse("Delete Keyframes: no keyframe is chosen");
    const std::vector<float64> keys = main->KeyTimes();
    const bool every = std::all_of(keys.begin(), keys.end(),
                                   [&](float64 t) { return std::find(times.begin(), times.end(), t) != times.end(); });
    mControl.OpenStep("Delete Keyframes");
    bool done = false;
    if (every)
        done = main->Animate(false);
    else
        for (const float64 t : times)
            done = main->RemoveKey(t) || done;
    mControl.CloseStep();
    mControl.Redraw();
    return done || Refuse("Delete Keyframes: there is no keyframe at those times");
}

bool PolyLineKeyEdit::JumpTo(float64 time)
{
    OrbaneDoc *doc = mControl.GetDoc();
    if (!doc)
        return Refuse("The shape belongs to no document");
    doc->SetCurrentTime(time);
    return true;
}

bool PolyLineKeyEdit::ToXYPath()
{
    if (!mControl.Editor().CanEdit())
        return false;
    const AutoRef<PolyLine> shape = mControl.Shape();
    Input *main = mControl.GetMainInput();
    Operator *tool = main->GetOperator();
    if (shape->GetCount() < 2)
        return Refuse("Convert to XYPath: a path needs two points or more");
    if (!tool)
        return Refuse("Convert to XYPath: the shape belongs to no tool");
    Input *axes[2] = {};
    for (int32 a = 0; a < 2; ++a) {
        const OrbID id((std::string(main->GetID().c_str()) + (a ? "Y" : "X")).c_str());
        axes[a] = tool->FindInput(id);
        if (axes[a] && axes[a]->GetDataType() != CLSID_DataType_Number)
            return Refuse("Convert to XYPath: the tool has an Input of that name that is not a number");
        if (!axes[a])
            axes[a] = tool->AddInput(id, id.c_str(), CLSID_DataType_Number, TagList(), AutoNumber(0.0).get());
    }
    std::vector<PolyPoint> points = shape->Points();
    if (shape->IsClosed())
        points.push_back(points.front());
    const float64 now = mControl.GetCurrentTime();
    mControl.OpenStep("Convert to XYPath");
    for (int32 a = 0; a < 2; ++a) {
        axes[a]->Animate(true);
        for (std::size_t i = 0; i < points.size(); ++i)
            axes[a]->SetValue(AutoNumber(a ? points[i].Y : points[i].X).get(), now + float64(i));
    }
    mControl.CloseStep();
    return true;
}

} // namespace Orbane
