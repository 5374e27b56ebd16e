#include "polyline/PolyLineCommandRunner.h"

#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineDialogs.h"
#include "polyline/PolyLineMenu.h"

#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/PolyLine.h"
#include "orbane/Prefs.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ShapeFile.h"

#include <QColor>
#include <QColorDialog>
#include <QFileDialog>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <utility>

namespace Orbane {

PolyLineCommandRunner::PolyLineCommandRunner(PolyLineControl &control, PreviewInfo *info, const TagList *tags)
    : mControl(control), mInfo(info), mTags(tags)
{
}

bool PolyLineCommandRunner::Run(int32 command, int32 arg)
{
    PolyLineControl &c = mControl;
    bool handled = false;
    const bool done = PolyLineDialogs(c, mInfo, Value()).Run(command, arg, handled);
    if (handled)
        return Edited(done);
    switch (command) {
    case PLCMD_ClickAppend:
    case PLCMD_DrawAppend:
    case PLCMD_InsertModify:
    case PLCMD_ModifyOnly:
    case PLCMD_Done:
    case PLCMD_FinishMode:
    case PLCMD_SetFocus:
        return Mode(command);
    case PLCMD_Closed: {
        const AutoRef<PolyLine> shape = c.Shape();
        return Edited(c.mEditor.SetClosed(!(shape && shape->IsClosed())));
    }
    case PLCMD_ClosePolygon:
        return Edited(c.mEditor.SetClosed(true));
    case PLCMD_ShowKeyPoints:
    case PLCMD_ShowHandles:
    case PLCMD_ShowPolygon:
    case PLCMD_ShowTaggedIDs:
    case PLCMD_DrawStyle:
    case PLCMD_ToggleMarkers:
        return Display(command, arg);
    case PLCMD_PointNumbers:
        return Toggle(c.mSurface->settings.pointNumbers);
    case PLCMD_CurrentTimeOnly:
        c.mEditor.SetCurrentTimeOnly(!c.mEditor.CurrentTimeOnly());
        c.Redraw();
        return true;
    case PLCMD_StopRendering:
        c.mStopRendering = c.mStopRendering ? 0 : 1;
        return true;
    case PLCMD_LockSelection:
        c.mEditor.SetSelectionLocked(!c.mEditor.IsSelectionLocked());
        return true;
    case PLCMD_PublishPathPoints:
        return Toggle(c.mSurface->settings.publishPathPoints);
    case PLCMD_LockPointPairs:
        c.mEditor.SetLockPairs(!c.mEditor.LockPairs());
        return true;
    case PLCMD_MultiFrame:
        c.mEditor.SetMultiFrame(std::clamp(arg, 0, 3));
        return true;
    case PLCMD_EditMultiplePolys:
        return EditMultiplePolys();
    case PLCMD_SelectAll:
        return Edited(c.mEditor.SelectAll());
    case PLCMD_NextPoint:
        return Edited(c.mEditor.SelectNext(arg));
    case PLCMD_NextKeyframe:
        return NextKeyframe(arg);
    case PLCMD_ToBSpline:
    case PLCMD_ToBezier:
        return Convert(command);
    case PLCMD_SplineColor:
    case PLCMD_KeyPointColor:
    case PLCMD_HandleColor:
        return Color(command);
    case PLCMD_Export:
        return ExportShape();
    case PLCMD_ImportShape:
        return ImportShape();
    case PLCMD_ImportMot:
    case PLCMD_ImportMotionPath:
    case PLCMD_ImportSsf:
    case PLCMD_ImportFxs:
    case PLCMD_ImportNuke:
    case PLCMD_ImportBoujou:
        return Import(command);
    default:
        break;
    }
    if (command >= PLCMD_RecordTime && command < PLCMD_RecordTime + 6) {
        bool *flags[] = {&c.mRecordTime,    &c.mRecordPressure, &c.mRecordHeight,
                         &c.mRecordAngleXY, &c.mRecordAngleZ,   &c.mRecordRotation};
        return Toggle(*flags[command - PLCMD_RecordTime]);
    }
    if (command >= PLCMD_OnionEnable && command <= PLCMD_OnionResetPrevColor)
        return Onion(command);
    if ((command >= PLCMD_RotoEnable && command <= PLCMD_RotoResetPattern) || command == PLCMD_AutoRotoEdges)
        return Roto(command);
    return Editing(command, arg);
}

// --- plain settings ---

// "Set Focus" makes this shape the one being edited: lit, switched on and
// out of "Done". Return and Enter end a drawing mode ("Insert and Modify"
// then) or the editing ("Done").
bool PolyLineCommandRunner::Mode(int32 command)
{
    PolyLineControl &c = mControl;
    int32 mode = command - PLCMD_ClickAppend + 1;
    if (command == PLCMD_Done)
        mode = PolyLineControl::PLM_Done;
    if (command == PLCMD_FinishMode)
        mode = c.IsAppending() ? PolyLineControl::PLM_InsertModify : PolyLineControl::PLM_Done;
    if (command == PLCMD_SetFocus) {
        c.SetDimmed(false);
        c.SetActive(1, nullptr);
        mode = c.ModeOf() == PolyLineControl::PLM_Done ? int32(PolyLineControl::PLM_InsertModify) : int32(c.ModeOf());
    }
    c.SetMode(uint8(mode));
    c.Redraw();
    return true;
}

bool PolyLineCommandRunner::Toggle(bool &flag)
{
    flag = !flag;
    mControl.Redraw();
    return true;
}

// The display flags: each entry flips its bit; "V" flips key points and
// handles together (both on unless both were on).
bool PolyLineCommandRunner::Display(int32 command, int32 arg)
{
    PolyLineControl &c = mControl;
    uint16 bit = 0;
    switch (command) {
    case PLCMD_ShowKeyPoints:
        bit = PLD_KeyPoints;
        break;
    case PLCMD_ShowHandles:
        if (arg == 1)
            return Toggle(c.mSurface->settings.hull);
        bit = PLD_Handles;
        break;
    case PLCMD_ShowPolygon:
        bit = PLD_Curve;
        break;
    case PLCMD_ShowTaggedIDs:
        bit = PLD_TaggedIDs;
        break;
    case PLCMD_DrawStyle:
        c.ReadDrawStyle(arg);
        c.Redraw();
        return true;
    default: { // ToggleMarkers
        const uint16 both = PLD_KeyPoints | PLD_Handles;
        const bool allOn = (c.mDisplayFlags & both) == both;
        c.mDisplayFlags = uint16(allOn ? c.mDisplayFlags & ~both : c.mDisplayFlags | both);
        c.EmptySelectionWhenHidden();
        c.Redraw();
        return true;
    }
    }
    c.mDisplayFlags ^= bit;
    c.EmptySelectionWhenHidden();
    c.Redraw();
    return true;
}

bool PolyLineCommandRunner::EditMultiplePolys()
{
    OrbaneDoc *doc = mControl.GetDoc();
    if (!doc)
        return Tell("Edit Multiple Polylines: the shape belongs to no document");
    const bool on = doc->GetPrefs().GetLong(PREF_SelectPointsFromMultiPolies, 0) != 0;
    doc->SetPref(PREF_SelectPointsFromMultiPolies, int64(on ? 0 : 1));
    return true;
}

// --- the shape ---

bool PolyLineCommandRunner::Editable(const char *what)
{
    if (!mControl.GetMainInput())
        return Tell(std::string(what) + ": there is no shape");
    if (mControl.mShapeReadOnly)
        return Tell(std::string(what) + ": the shape is read-only");
    if (mControl.IsToolLocked())
        return Tell(std::string(what) + ": the tool is locked");
    return true;
}

bool PolyLineCommandRunner::Write(const char *undo, PolyLine *shape)
{
    mControl.OpenStep(undo);
    const bool written = mControl.WriteShape(shape);
    mControl.CloseStep();
    if (!written)
        return Tell(std::string(undo) + ": the shape was not written");
    mControl.Redraw();
    return true;
}

// Bezier and B-spline convert into each other where the Input holds either.
bool PolyLineCommandRunner::Convert(int32 command)
{
    const char *what = command == PLCMD_ToBSpline ? "Bezier to B-Spline" : "B-Spline to Bezier";
    if (!Editable(what))
        return false;
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (!shape || shape->GetCount() == 0)
        return Tell(std::string(what) + ": the shape is empty");
    const OrbID &to = command == PLCMD_ToBSpline ? CLSID_DataType_BSplinePolyline : CLSID_DataType_Polyline;
    if (shape->DataType() == to)
        return Tell(std::string(what) + ": the shape is of that kind already");
    AutoRef<PolyLine> converted(shape->Convert(to));
    return converted && Write(what, converted.get());
}

// --- values a dialog asks for ---

bool PolyLineCommandRunner::FromScript() const
{
    return mTags && mTags->GetLong(PCA_FromScript, 0) != 0;
}

std::string PolyLineCommandRunner::Value() const
{
    const char *value = mTags ? mTags->GetString(PCA_CommandValue, nullptr) : nullptr;
    return value ? value : "";
}

void PolyLineCommandRunner::AskFile(bool save, const char *title, std::function<void(const std::string &)> done)
{
    PolyLineControl &c = mControl;
    if (!c.mSurface->dialogs)
        c.mSurface->dialogs = std::make_unique<QObject>();
    auto *dialog = new QFileDialog(nullptr, QString::fromUtf8(title));
    dialog->setAcceptMode(save ? QFileDialog::AcceptSave : QFileDialog::AcceptOpen);
    dialog->setNameFilters({"Shapes (*.shape *.svg)", "All files (*)"});
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    QObject::connect(c.mSurface->dialogs.get(), &QObject::destroyed, dialog, &QObject::deleteLater);
    QObject::connect(dialog, &QFileDialog::fileSelected, c.mSurface->dialogs.get(),
                     [done](const QString &path) { done(path.toStdString()); });
    dialog->open();
}

void PolyLineCommandRunner::AskColor(OrbColor current, std::function<void(OrbColor)> done)
{
    PolyLineControl &c = mControl;
    if (!c.mSurface->dialogs)
        c.mSurface->dialogs = std::make_unique<QObject>();
    const QColor start = current.IsNone() ? QColor(Qt::white) : QColor(current.R(), current.G(), current.B());
    auto *dialog = new QColorDialog(start);
    dialog->setAttribute(Qt::WA_DeleteOnClose);
    QObject::connect(c.mSurface->dialogs.get(), &QObject::destroyed, dialog, &QObject::deleteLater);
    QObject::connect(dialog, &QColorDialog::colorSelected, c.mSurface->dialogs.get(), [done](const QColor &q) {
        done(OrbColor(uint8(q.red()), uint8(q.green()), uint8(q.blue()), 255));
    });
    dialog->open();
}

// A custom colour from a script is "#rrggbb" ("none" clears it); from the
// window the colour dialog asks.
bool PolyLineCommandRunner::Color(int32 command)
{
    PolyLineControl &c = mControl;
    const char *what = command == PLCMD_SplineColor     ? "Custom Spline Color"
                       : command == PLCMD_KeyPointColor ? "Custom Key Point Color"
                                                        : "Custom Handle Color";
    auto apply = [&c, command](OrbColor colour) {
        if (command == PLCMD_SplineColor)
            c.mCustomSplineColor = colour;
        else if (command == PLCMD_KeyPointColor)
            c.mCustomKeyPointColor = colour;
        else
            c.mHandleColor = c.mHandleColorAlt = colour.IsNone() ? OrbColor(192, 192, 0, 255) : colour;
        c.Redraw();
    };
    const std::string value = Value();
    if (value == "none") {
        apply(OrbColor());
        return true;
    }
    if (!value.empty()) {
        const QColor q(QString::fromStdString(value));
        if (!q.isValid())
            return Tell(std::string(what) + ": \"" + value + "\" is not a colour (give \"#rrggbb\" or \"none\")");
        apply(OrbColor(uint8(q.red()), uint8(q.green()), uint8(q.blue()), 255));
        return true;
    }
    if (FromScript())
        return Tell(std::string(what) + ": give the colour as \"#rrggbb\" (or \"none\")");
    const OrbColor current = command == PLCMD_SplineColor     ? c.mCustomSplineColor
                             : command == PLCMD_KeyPointColor ? c.mCustomKeyPointColor
                                                              : c.mHandleColor;
    AskColor(current, apply);
    return true;
}

bool PolyLineCommandRunner::ExportShape()
{
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (!shape || shape->GetCount() == 0)
        return Tell("Export: the shape is empty");
    const float64 w = mInfo && mInfo->ImageWidth > 0 ? mInfo->ImageWidth : 1920.0;
    const float64 h = mInfo && mInfo->ImageHeight > 0 ? mInfo->ImageHeight : 1080.0;
    PolyLineControl *c = &mControl;
    auto write = [c, shape, w, h](const std::string &path) {
        std::string error;
        if (!ShapeFile::Export(path, *shape, w, h, &error))
            c->Tell(("Export: " + error).c_str());
    };
    const std::string path = Value();
    if (!path.empty()) {
        std::string error;
        if (!ShapeFile::Export(path, *shape, w, h, &error))
            return Tell("Export: " + error);
        return true;
    }
    if (FromScript())
        return Tell("Export: give the file to write");
    AskFile(true, "Export Shape", write);
    return true;
}

bool PolyLineCommandRunner::ImportShape()
{
    if (!Editable("Import Shape"))
        return false;
    PolyLineControl *c = &mControl;
    auto read = [c](const std::string &path) {
        std::string error;
        AutoRef<PolyLine> shape(ShapeFile::Import(path, &error));
        if (!shape) {
            c->Tell(("Import Shape: " + error).c_str());
            return false;
        }
        c->mSelection.Reset();
        c->OpenStep("Import Shape");
        const bool written = c->WriteShape(shape.get());
        c->CloseStep();
        c->ResetUndo(nullptr);
        if (!written)
            c->Tell("Import Shape: this Input does not take that kind of shape");
        return written;
    };
    const std::string path = Value();
    if (!path.empty())
        return read(path);
    if (FromScript())
        return Tell("Import Shape: give the file to read");
    AskFile(false, "Import Shape", [read](const std::string &file) { read(file); });
    return true;
}

bool PolyLineCommandRunner::Import(int32 command)
{
    const char *format = command == PLCMD_ImportMot          ? "LightWave MOT"
                         : command == PLCMD_ImportMotionPath ? "motion path"
                         : command == PLCMD_ImportSsf        ? "SSF shape"
                         : command == PLCMD_ImportFxs        ? "FXS (Silhouette) shape"
                         : command == PLCMD_ImportNuke       ? "Nuke shape"
                                                             : "Boujou path";
    return Tell(std::string("Import: the ") + format +
                " format is not read yet; \"Import Shape…\" reads shape and SVG files");
}

// --- time ---

bool PolyLineCommandRunner::Onion(int32 command)
{
    PolyLineSettings &s = mControl.mSurface->settings;
    switch (command) {
    case PLCMD_OnionEnable:
        return Toggle(s.onionEnabled);
    case PLCMD_OnionClickTime:
    case PLCMD_OnionClickArmed:
        return Toggle(s.onionClickTime);
    case PLCMD_OnionResetAnchor:
        s.onionAnchor = mControl.GetCurrentTime();
        return true;
    case PLCMD_OnionSetPrevColor: {
        const std::string value = Value();
        if (!value.empty() && QColor(QString::fromStdString(value)).isValid()) {
            const QColor q(QString::fromStdString(value));
            s.onionPrevColor = OrbColor(uint8(q.red()), uint8(q.green()), uint8(q.blue()), 255);
            mControl.Redraw();
            return true;
        }
        if (FromScript())
            return Tell("Set prev skin color: give the colour as \"#rrggbb\"");
        PolyLineControl *c = &mControl;
        AskColor(s.onionPrevColor, [c](OrbColor colour) {
            c->mSurface->settings.onionPrevColor = colour;
            c->Redraw();
        });
        return true;
    }
    default: // reset the colour before now
        s.onionPrevColor = OrbColor();
        mControl.Redraw();
        return true;
    }
}

// The tracker's settings are plain flags and numbers; tracking itself needs
// a tracker, which there is not yet.
bool PolyLineCommandRunner::Roto(int32 command)
{
    PolyLineSettings &s = mControl.mSurface->settings;
    switch (command) {
    case PLCMD_RotoEnable:
        return Toggle(s.rotoEnabled);
    case PLCMD_RotoMultiple:
        return Toggle(s.rotoMultiple);
    case PLCMD_RotoShowArea:
        return Toggle(s.rotoShowArea);
    case PLCMD_RotoPatternEdit:
        return Toggle(s.rotoPatternEdit);
    case PLCMD_RotoTrackPoints:
        return Toggle(s.rotoTrackPoints);
    case PLCMD_RotoDistance:
        return Number("Distance", s.rotoDistance, 1, 1000);
    case PLCMD_RotoFrameSkip:
        return Number("Frame Skip", s.rotoFrameSkip, 1, 1000);
    case PLCMD_AutoRotoEdges:
        return Tell("Auto-roto Edges: edge tracing is not built yet");
    default:
        return Tell("Roto Assist: there is no tracker yet to create, reset or follow track points");
    }
}

bool PolyLineCommandRunner::Number(const char *what, int32 &field, int32 low, int32 high)
{
    const std::string value = Value();
    char *end = nullptr;
    const long n = value.empty() ? 0 : std::strtol(value.c_str(), &end, 10);
    if (value.empty() || *end || n < low || n > high)
        return Tell(std::string(what) + ": give a whole number from " + std::to_string(low) + " to " +
                    std::to_string(high) + " (now " + std::to_string(field) + ")");
    field = int32(n);
    return true;
}

bool PolyLineCommandRunner::NextKeyframe(int32 step)
{
    Input *main = mControl.GetMainInput();
    OrbaneDoc *doc = mControl.GetDoc();
    if (!main || !doc || !main->IsAnimated())
        return Tell("Keyframes: the shape is not animated");
    const std::vector<float64> keys = main->KeyTimes();
    const float64 now = doc->GetCurrentTime();
    const float64 *to = nullptr;
    if (step > 0) {
        const auto it = std::upper_bound(keys.begin(), keys.end(), now + 1e-9);
        to = it == keys.end() ? nullptr : &*it;
    } else {
        const auto it = std::lower_bound(keys.begin(), keys.end(), now - 1e-9);
        to = it == keys.begin() ? nullptr : &*(it - 1);
    }
    if (!to)
        return Tell(step > 0 ? "Keyframes: there is no later keyframe" : "Keyframes: there is no earlier keyframe");
    doc->SetCurrentTime(*to);
    return true;
}

// --- the editing operations ---

// The edits of the points are the editor's; it refuses with a message.
bool PolyLineCommandRunner::Editing(int32 command, int32 arg)
{
    PolyLineEditor &e = mControl.mEditor;
    switch (command) {
    case PLCMD_DeletePoints:
        return Edited(e.DeleteSelected());
    case PLCMD_Smooth:
        return Edited(e.Smooth());
    case PLCMD_Linear:
        return Edited(e.MakeLinear());
    case PLCMD_FlipPoints:
        return Edited(e.Flip(arg == 0 ? Qt::Horizontal : Qt::Vertical));
    case PLCMD_TagPoints:
        return Edited(e.TagSelected());
    case PLCMD_LockPoints:
        return Edited(e.LockSelected(!e.IsSelectionLockedPoint()));
    case PLCMD_Copy:
        return Edited(e.Copy());
    case PLCMD_CopyPathValue:
        return Edited(e.CopyPathValue());
    case PLCMD_Cut:
        return Edited(e.Cut());
    case PLCMD_Paste:
        return Edited(e.Paste());
    case PLCMD_PasteWithOffset:
        return Edited(e.PasteWithOffset(e.DefaultPasteOffset()));
    case PLCMD_OuterMakeRemove:
        return Edited(mControl.Pairing() == PolyLineControl::PAIR_Free ? e.RemoveOuter() : e.MakeOuter());
    case PLCMD_OuterEnable:
        return Edited(e.EnableOuter());
    case PLCMD_OuterReset:
        return Edited(e.ResetOuter());
    case PLCMD_FollowInner:
        return Edited(e.FollowInner());
    case PLCMD_ShapeBox: {
        // The entry switches its box on, or off again where it is on.
        const int32 mode = arg == 1 ? PolyLineEditor::SB_Both : PolyLineEditor::SB_Shape;
        e.SetShapeBox(e.GetShapeBox() == mode ? int32(PolyLineEditor::SB_Off) : mode);
        mControl.Redraw();
        return true;
    }
    case PLCMD_Subdivide:
        return Edited(e.Subdivide());
    case PLCMD_PublishPoints:
        return Edited(e.PublishSelected());
    case PLCMD_UnpublishPoints:
        return Edited(e.Unpublish());
    case PLCMD_PublishAll:
        return Edited(e.SelectAll() && e.PublishSelected());
    case PLCMD_FollowNearby:
        return Edited(e.FollowNearby());
    case PLCMD_StopFollowing:
        return Edited(e.StopFollowing());
    case PLCMD_PublishTo:
        return Edited(e.PublishTo(arg));
    default:
        return Tell("Polyline: unknown command " + std::to_string(command));
    }
}

bool PolyLineCommandRunner::Edited(bool done)
{
    mControl.Redraw();
    return done;
}

bool PolyLineCommandRunner::Tell(const std::string &message)
{
    mControl.Tell(message.c_str());
    return false;
}

} // namespace Orbane
