#include "inputcontrols/LogControl.h"

#include "inputcontrols/CurveTable.h"
#include "widgets/CurveGraph.h"

#include "orbane/ElideLabel.h"
#include "orbane/ScriptValParam.h"
#include "orbane/TimeCodeEdit.h"

#include <QLabel>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Log.Layout";
constexpr int32 kSamples = 128;
// Child names, value keys and captions, in the order of the edits.
constexpr const char *kNames[4] = {"black", "white", "gamma", "softclip"};
constexpr const char *kKeys[4] = {"black", "white", "filmGamma", "softClip"};
constexpr const char *kCaptions[4] = {"Black", "White", "Film Gamma", "Soft Clip"};
constexpr int32 kPlaces[4] = {0, 0, 3, 3};
const QColor kCurveColour(230, 200, 120);
const QColor kClipColour(200, 200, 200, 120);

float64 &Field(TransferFunctions::LogSettings &s, int32 i)
{
    float64 *fields[4] = {&s.black, &s.white, &s.filmGamma, &s.softClip};
    return *fields[i];
}

} // namespace

LogControl::LogControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : TableInputControl(reg, args, tags), mGraph(new CurveGraph(this))
{
    for (int32 i = 0; i < 4; ++i) {
        mEdits[std::size_t(i)] = new TimeCodeEdit(this);
        mEdits[std::size_t(i)]->setObjectName(kNames[i]);
        connect(mEdits[std::size_t(i)], SIGNAL(editingFinished()), this, SLOT(OnTyped()));
        RegisterChild(kNames[i], mEdits[std::size_t(i)]);
        mCaptions[std::size_t(i)] = new QLabel(kCaptions[i], this);
        RegisterChild((std::string(kNames[i]) + "caption").c_str(), mCaptions[std::size_t(i)]);
    }
    mGraph->setObjectName("graph");
    RegisterChild("graph", mGraph);
    mGraph->SetDiagonal(false);
    // The linear values run past 1 where the white code value is below 1023.
    mGraph->SetDefaultView(QRectF(0.0, 0.0, 1.0, 1.5));
    Label()->setFocusProxy(mEdits[0]);
    ClassLayout(kLayoutItem);
}

LogControl::~LogControl() = default;

TransferFunctions::LogSettings LogControl::SettingsOf(const ScriptVal &table)
{
    TransferFunctions::LogSettings s;
    for (int32 i = 0; i < 4; ++i)
        Field(s, i) = CurveTable::NumberAt(table, kKeys[i], Field(s, i));
    return s.Tidy();
}

ScriptVal LogControl::TableOf(const TransferFunctions::LogSettings &settings)
{
    ScriptVal table = ScriptVal::NewTable();
    TransferFunctions::LogSettings s = settings;
    for (int32 i = 0; i < 4; ++i)
        table.SetKey(ScriptVal(kKeys[i]), ScriptVal(Field(s, i)));
    return table;
}

bool LogControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!TableInputControl::Open(host, rect, tags))
        return false;
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

void LogControl::ShowValue()
{
    TransferFunctions::LogSettings s = SettingsOf(Value());
    for (int32 i = 0; i < 4; ++i)
        if (!mEdits[std::size_t(i)]->isModified())
            mEdits[std::size_t(i)]->SetValue(Field(s, i), kPlaces[i]);
    const auto curve = [s](float64 x) {
        return TransferFunctions::LogToLinear(x * TransferFunctions::LogSettings::kMaxCode, s);
    };
    mGraph->SetPlots({{{QPointF(0.0, 1.0), QPointF(1.0, 1.0)}, kClipColour, true},
                      {TransferFunctions::Sample(curve, 0.0, 1.0, kSamples), kCurveColour, false}});
}

// A typed value is tidied with the others (black below white, and so on)
// and written as one step.
void LogControl::OnTyped()
{
    for (int32 i = 0; i < 4; ++i) {
        TimeCodeEdit *edit = mEdits[std::size_t(i)];
        if (sender() != edit || !edit->isModified())
            continue;
        edit->setModified(false);
        bool ok = false;
        const float64 typed = edit->GetValue(&ok);
        TransferFunctions::LogSettings s = SettingsOf(Value());
        if (ok && std::isfinite(typed)) {
            Field(s, i) = typed;
            const ScriptVal table = TableOf(s.Tidy());
            if (!Value().IsTable() || !ScriptValParam::DeepEquals(TableOf(SettingsOf(Value())), table))
                WriteValue(table);
            EndGesture();
        }
        ShowValue();
    }
}

} // namespace Orbane
