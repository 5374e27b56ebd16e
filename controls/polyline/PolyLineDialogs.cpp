#include "polyline/PolyLineDialogs.h"

#include "polyline/PolyKeyListDlg.h"
#include "polyline/PolyLineAnimation.h"
#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineKeyEdit.h"
#include "polyline/PolyLineMenu.h"
#include "polyline/PolyLineShapes.h"
#include "polyline/PolyOnionDialog.h"
#include "polyline/PolyPointDialog.h"

#include "orbane/PolyLine.h"
#include "orbane/PreviewInfo.h"

#include <algorithm>

namespace Orbane {

namespace {

// The smoothing that the "Default" entries apply.
constexpr float64 kDefaultSmooth = 0.5;
constexpr int32 kDefaultPasses = 1;
constexpr int32 kMaxPasses = 100;
// A shape made by "Create" fills half the image about its centre.
constexpr float64 kCreateRadius = 0.25;

// Shows `dialog` (made when there is none yet) in front.
template <class D, class Make> D *Raise(QPointer<QDialog> &slot, Make make)
{
    if (!slot)
        slot = make();
    auto *dialog = static_cast<D *>(slot.data());
    dialog->show();
    dialog->raise();
    return dialog;
}

} // namespace

PolyLineDialogs::PolyLineDialogs(PolyLineControl &control, PreviewInfo *info, std::string value)
    : mControl(control), mSurface(*control.mSurface), mValue(std::move(value))
{
    if (info && info->DialogParent())
        mSurface.dialogParent = info->DialogParent();
    mParent = mSurface.dialogParent;
}

bool PolyLineDialogs::Run(int32 command, int32 arg, bool &handled)
{
    handled = true;
    switch (command) {
    case PLCMD_EditPoint:
        return PointEditor();
    case PLCMD_KeyframeList:
        return KeyList();
    case PLCMD_OnionSettings:
        return Onion();
    case PLCMD_CreateEllipse:
    case PLCMD_CreateRectangle:
    case PLCMD_CreateArrow:
        return Create(command);
    case PLCMD_ReducePoints:
        return Reduce();
    case PLCMD_SmoothPoints:
        return SmoothPoints(arg == 0);
    case PLCMD_SmoothAnimation:
        return SmoothAnimation(arg == 0);
    case PLCMD_EaseInOut:
        return EaseInOut();
    case PLCMD_CardinalToBezier:
        return CardinalToBezier();
    case PLCMD_ToXYPath:
        return PolyLineKeyEdit(mControl).ToXYPath();
    default:
        handled = false;
        return false;
    }
}

void PolyLineDialogs::Follow(PolyLineSurface &surface)
{
    if (auto *point = static_cast<PolyPointDialog *>(surface.pointEditor.data()); point && point->isVisible())
        point->Follow();
    if (auto *keys = static_cast<PolyKeyListDlg *>(surface.keyList.data()); keys && keys->isVisible())
        keys->Refresh();
}

bool PolyLineDialogs::Tell(const std::string &message)
{
    mControl.Tell(message.c_str());
    return false;
}

// --- the dialogs of their own ---

bool PolyLineDialogs::PointEditor()
{
    PolyLineControl *c = &mControl;
    Raise<PolyPointDialog>(mSurface.pointEditor, [&] { return new PolyPointDialog(*c, mParent); })->Load();
    return true;
}

bool PolyLineDialogs::KeyList()
{
    PolyLineControl *c = &mControl;
    Raise<PolyKeyListDlg>(mSurface.keyList, [&] { return new PolyKeyListDlg(*c, mParent); })->Refresh();
    return true;
}

bool PolyLineDialogs::Onion()
{
    PolyLineControl *c = &mControl;
    PolyLineSettings *s = &mSurface.settings;
    Raise<PolyOnionDialog>(mSurface.onion, [&] { return new PolyOnionDialog(*c, *s, mParent); })->Load();
    return true;
}

// --- the dialogs of numbers ---

bool PolyLineDialogs::Numbers(const char *title, const char *name, std::vector<PolyNumbersDialog::Field> fields,
                              Apply apply)
{
    if (!mValue.empty()) {
        std::vector<float64> values;
        std::string why;
        if (!PolyNumbersDialog::Parse(fields, mValue, values, why))
            return Tell(std::string(title) + ": " + why);
        return apply(values);
    }
    PolyLineControl *c = &mControl;
    auto done = [c, apply](const std::vector<float64> &values) -> std::string {
        const bool ok = apply(values);
        c->ResetUndo(nullptr);
        return ok ? std::string() : std::string(c->LastMessage().c_str());
    };
    delete mSurface.numbers.data();
    mSurface.numbers = new PolyNumbersDialog(mParent, QString::fromUtf8(title), name, std::move(fields), done);
    mSurface.numbers->setAttribute(Qt::WA_DeleteOnClose);
    mSurface.numbers->show();
    return true;
}

bool PolyLineDialogs::Create(int32 command)
{
    PolyLineControl *c = &mControl;
    const float64 r = kCreateRadius;
    // The new shape replaces the points there are, as one step.
    auto make = [c](const char *what, const std::function<bool(PolyLine &)> &build) {
        if (!c->Editor().CanEdit())
            return false;
        AutoRef<PolyLine> made(static_cast<PolyLine *>(c->Shape()->Clone()));
        if (!build(*made)) {
            c->Tell((std::string(what) + ": the shape could not be made").c_str());
            return false;
        }
        c->mSelection.Reset();
        c->OpenStep(what);
        const bool written = c->WriteShape(made.get());
        c->CloseStep();
        c->Redraw();
        return written;
    };
    using F = PolyNumbersDialog::Field;
    if (command == PLCMD_CreateEllipse)
        return Numbers("Create Ellipse", "ellipseEditor",
                       {F{"Centre X", "ellipseX", 0.5, -10, 10, false}, F{"Centre Y", "ellipseY", 0.5, -10, 10, false},
                        F{"Radius X", "ellipseRadiusX", r, 1e-6, 10, false},
                        F{"Radius Y", "ellipseRadiusY", r, 1e-6, 10, false},
                        F{"Points", "ellipsePoints", 4, 3, 360, true}},
                       [make](const std::vector<float64> &v) {
                           return make("Create Ellipse",
                                       [&](PolyLine &s) { return s.MakeEllipse(v[0], v[1], v[2], v[3], int32(v[4])); });
                       });
    if (command == PLCMD_CreateRectangle)
        return Numbers(
            "Create Rectangle", "rectangleEditor",
            {F{"Centre X", "rectangleX", 0.5, -10, 10, false}, F{"Centre Y", "rectangleY", 0.5, -10, 10, false},
             F{"Width", "rectangleWidth", 2 * r, 1e-6, 20, false},
             F{"Height", "rectangleHeight", 2 * r, 1e-6, 20, false}},
            [make](const std::vector<float64> &v) {
                return make("Create Rectangle", [&](PolyLine &s) { return s.MakeRectangle(v[0], v[1], v[2], v[3]); });
            });
    if (mControl.IsShapeReadOnly())
        return Tell("Create Arrow: the shape is read-only");
    return Numbers("Create Arrow", "arrowEditor",
                   {F{"From X", "arrowFromX", 0.5 - r, -10, 10, false}, F{"From Y", "arrowFromY", 0.5, -10, 10, false},
                    F{"To X", "arrowToX", 0.5 + r, -10, 10, false}, F{"To Y", "arrowToY", 0.5, -10, 10, false},
                    F{"Shaft width", "arrowShaft", r / 5, 1e-6, 10, false},
                    F{"Head width", "arrowHeadWidth", r / 2, 1e-6, 10, false},
                    F{"Head length", "arrowHeadLength", r / 2, 1e-6, 10, false}},
                   [make](const std::vector<float64> &v) {
                       return make("Create Arrow",
                                   [&](PolyLine &s) { return s.MakeArrow(v[0], v[1], v[2], v[3], v[4], v[5], v[6]); });
                   });
}

// "Reduce Points…": the tolerance in viewer pixels; the overlay's freehand
// tolerance is where the dialog starts.
bool PolyLineDialogs::Reduce()
{
    PolyLineControl *c = &mControl;
    const bool opens = mValue.empty();
    const bool done = Numbers(
        "Reduce Points", "reduceEditor",
        {PolyNumbersDialog::Field{"Tolerance (pixels)", "reduceTolerance", c->ReduceTolerance(), 0.01, 1000, false}},
        [c](const std::vector<float64> &v) { return c->Editor().Reduce(v[0]); });
    if (opens && mSurface.numbers) {
        mSurface.settings.reduceOpen = true;
        PolyLineSettings *s = &mSurface.settings;
        QObject::connect(mSurface.numbers.data(), &QDialog::finished, [s](int) { s->reduceOpen = false; });
    }
    return done;
}

bool PolyLineDialogs::SmoothPoints(bool ask)
{
    PolyLineControl *c = &mControl;
    auto apply = [c](const std::vector<float64> &v) {
        c->mSurface->settings.smoothAmount = v[0];
        c->mSurface->settings.smoothPasses = int32(v[1]);
        const float64 amount = v[0];
        const int32 passes = int32(v[1]);
        const bool none = c->Selection().GetSetCount() == 0;
        if (!c->Editor().CanEdit())
            return false;
        const std::vector<uint8> movable = PolyLineShapes::Movable(*c->Shape(), c->Selection());
        return c->Editor().Commit(
            "Smooth Points",
            [&](PolyLine &s) {
                return PolyLineAnimation::SmoothPoints(s, none ? nullptr : movable.data(), amount, passes);
            },
            false);
    };
    if (!ask)
        return apply({kDefaultSmooth, float64(kDefaultPasses)});
    const PolyLineSettings &s = mSurface.settings;
    return Numbers("Smooth Points", "smoothPointsDialog",
                   {PolyNumbersDialog::Field{"Amount", "smoothAmount", s.smoothAmount, 0.0, 1.0, false},
                    PolyNumbersDialog::Field{"Passes", "smoothPasses", float64(s.smoothPasses), 1, kMaxPasses, true}},
                   apply);
}

bool PolyLineDialogs::SmoothAnimation(bool ask)
{
    PolyLineControl *c = &mControl;
    auto apply = [c](const std::vector<float64> &v) {
        c->mSurface->settings.smoothAmount = v[0];
        c->mSurface->settings.smoothPasses = int32(v[1]);
        return PolyLineKeyEdit(*c).SmoothAnimation(v[0], int32(v[1]));
    };
    if (!ask)
        return apply({kDefaultSmooth, float64(kDefaultPasses)});
    const PolyLineSettings &s = mSurface.settings;
    return Numbers("Smooth Animation", "smoothAnimationDialog",
                   {PolyNumbersDialog::Field{"Amount", "smoothAmount", s.smoothAmount, 0.0, 1.0, false},
                    PolyNumbersDialog::Field{"Passes", "smoothPasses", float64(s.smoothPasses), 1, kMaxPasses, true}},
                   apply);
}

bool PolyLineDialogs::EaseInOut()
{
    PolyLineControl *c = &mControl;
    const PolyLineSettings &s = mSurface.settings;
    return Numbers("Ease In / Out", "easeDialog",
                   {PolyNumbersDialog::Field{"Ease in", "easeIn", s.easeIn, 0.0, 1.0, false},
                    PolyNumbersDialog::Field{"Ease out", "easeOut", s.easeOut, 0.0, 1.0, false}},
                   [c](const std::vector<float64> &v) {
                       c->mSurface->settings.easeIn = v[0];
                       c->mSurface->settings.easeOut = v[1];
                       return PolyLineKeyEdit(*c).EaseInOut(v[0], v[1]);
                   });
}

// The selected points (every point where none is) take the handles of the
// Catmull-Rom spline through the key points.
bool PolyLineDialogs::CardinalToBezier()
{
    if (!mControl.Editor().CanEdit())
        return false;
    const bool none = mControl.Selection().GetSetCount() == 0;
    const std::vector<uint8> movable = PolyLineShapes::Movable(*mControl.Shape(), mControl.Selection());
    return mControl.Editor().Commit(
        "Cardinal to Bezier",
        [&](PolyLine &s) { return PolyLineAnimation::CardinalToBezier(s, none ? nullptr : movable.data(), 0.0); },
        false);
}

} // namespace Orbane
