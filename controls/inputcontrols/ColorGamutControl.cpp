#include "inputcontrols/ColorGamutControl.h"

#include "widgets/GamutDiagram.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Input.h"

#include <QComboBox>
#include <QLabel>

#include <cmath>

namespace Orbane {

using Chromaticity::XY;

namespace {

constexpr const char *kLayoutItem = "Controls.ColorGamut.Layout";
constexpr const char *kPointKeys[4] = {"red", "green", "blue", "white"};

bool ReadPoint(const ScriptVal &value, const char *key, XY &out)
{
    const ScriptVal *p = value.FindKeyConst(ScriptVal(key));
    const ScriptVal *x = p ? p->FindKeyConst(ScriptVal(1)) : nullptr;
    const ScriptVal *y = p ? p->FindKeyConst(ScriptVal(2)) : nullptr;
    if (!x || !y || !x->IsNumber() || !y->IsNumber() || !std::isfinite(x->GetNumber()) ||
        !std::isfinite(y->GetNumber()))
        return false;
    out = {x->GetNumber(), y->GetNumber()};
    return true;
}

} // namespace

ColorGamutControl::ColorGamutControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mSpaces(new QComboBox(this)), mDiagram(new GamutDiagram),
      mReadout(new QLabel(this))
{
    Chromaticity::StandardGamut("Rec. 709", mGamut);
    mSpace = "Rec. 709";
    // Painted widgets are made without a parent, then adopted.
    mDiagram->setParent(this);
    mDiagram->SetOwner(this);
    for (const std::string &name : Chromaticity::SpaceNames())
        mSpaces->addItem(QString::fromStdString(name));
    mSpaces->addItem(kCustom);
    const std::pair<const char *, QWidget *> children[] = {
        {"space", mSpaces}, {"diagram", mDiagram}, {"readout", mReadout}};
    for (const auto &[name, child] : children) {
        child->setObjectName(name);
        RegisterChild(name, child);
    }
    connect(mSpaces, SIGNAL(activated(int)), this, SLOT(OnSpaceChosen(int)));
    connect(mDiagram, SIGNAL(Moved(int, float64, float64)), this, SLOT(OnMoved(int, float64, float64)));
    connect(mDiagram, SIGNAL(Released()), this, SLOT(OnReleased()));
    Label()->setFocusProxy(mSpaces);
    ClassLayout(kLayoutItem);
}

ColorGamutControl::~ColorGamutControl() = default;

bool ColorGamutControl::Read(const ScriptVal &value, Chromaticity::Gamut &gamut, std::string &space)
{
    Chromaticity::StandardGamut("Rec. 709", gamut);
    space = "Rec. 709";
    if (!value.IsTable())
        return false;
    const ScriptVal *name = value.FindKeyConst(ScriptVal("space"));
    Chromaticity::Gamut points = gamut;
    const bool named = name && Chromaticity::StandardGamut(name->GetString(), points);
    bool all = true;
    for (int32 i = 0; i < 4; ++i)
        all = ReadPoint(value, kPointKeys[i], Chromaticity::PointOf(points, i)) && all;
    // Points given win over the name; a name alone gives its published points.
    if (!named && !all)
        return false;
    gamut = points;
    space = named ? name->GetString() : kCustom;
    if (named && all) {
        Chromaticity::Gamut standard;
        Chromaticity::StandardGamut(space, standard);
        for (int32 i = 0; i < 4; ++i)
            if (Chromaticity::PointOf(standard, i).x != Chromaticity::PointOf(points, i).x ||
                Chromaticity::PointOf(standard, i).y != Chromaticity::PointOf(points, i).y)
                space = kCustom;
    }
    return true;
}

ScriptVal ColorGamutControl::ToScript(const Chromaticity::Gamut &gamut, const std::string &space)
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey(ScriptVal("space"), ScriptVal(space));
    for (int32 i = 0; i < 4; ++i) {
        const XY &p = Chromaticity::PointOf(gamut, i);
        ScriptVal xy = ScriptVal::NewTable();
        xy.Append(ScriptVal(p.x));
        xy.Append(ScriptVal(p.y));
        t.SetKey(ScriptVal(kPointKeys[i]), xy);
    }
    return t;
}

void ColorGamutControl::Take(const ScriptVal &value)
{
    const bool ok = Read(value, mGamut, mSpace);
    mDiagram->setToolTip(ok ? QString() : tr("Not a gamut: showing Rec. 709"));
}

bool ColorGamutControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    if (Input *in = GetCurrentInput()) {
        const AutoParameter now(in->GetValue(GetCurrentTime()));
        const auto *table = dynamic_cast<const ScriptValParam *>(now.get());
        Take(table ? table->Value : ScriptVal());
    }
    ShowChild(Label());
    ShowChild(mSpaces);
    ShowChild(mDiagram);
    ShowChild(mReadout);
    ShowValue();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

bool ColorGamutControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *table = dynamic_cast<const ScriptValParam *>(value);
    if (!table)
        return true;
    const ScriptVal before = ToScript(mGamut, mSpace);
    Take(table->Value);
    if (ScriptValParam::DeepEquals(before, ToScript(mGamut, mSpace)))
        return true;
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ColorGamutControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowValue();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void ColorGamutControl::ShowValue()
{
    if (!mGesture.IsOpen())
        mDiagram->SetGamut(mGamut);
    mSpaces->setCurrentText(QString::fromStdString(mSpace));
    QStringList parts;
    const char *letters[4] = {"R", "G", "B", "W"};
    for (int32 i = 0; i < 4; ++i) {
        const XY &p = Chromaticity::PointOf(mGamut, i);
        parts << QString::asprintf("%s %.4f %.4f", letters[i], p.x, p.y);
    }
    mReadout->setText(parts.join("  "));
}

void ColorGamutControl::OnSpaceChosen(int index)
{
    const std::string name = mSpaces->itemText(index).toStdString();
    Chromaticity::Gamut gamut;
    // "Custom" keeps the points as they are and only names them so.
    if (!Chromaticity::StandardGamut(name, gamut))
        gamut = mGamut;
    mGesture.Write(GetCurrentInput(), AutoScriptValParam(ToScript(gamut, name)), InputGesture::StepName(*this));
    mGesture.End();
    ShowValue();
}

void ColorGamutControl::OnMoved(int index, float64 x, float64 y)
{
    Chromaticity::Gamut gamut = mDiagram->GetGamut();
    Chromaticity::PointOf(gamut, index) = {x, y};
    mGesture.Write(GetCurrentInput(), AutoScriptValParam(ToScript(gamut, kCustom)), InputGesture::StepName(*this));
    ShowValue();
}

void ColorGamutControl::OnReleased()
{
    mGesture.End();
    mDiagram->SetGamut(mGamut);
    ShowValue();
}

bool ColorGamutControl::OnDisconnect(Input *input, const TagList *tags)
{
    if (input)
        input->SetValue(AutoScriptValParam(ToScript(mGamut, mSpace)), TIME_DISCONNECT, SETVALUE_NoUndo, nullptr);
    return LabelledInputControl::OnDisconnect(input, tags);
}

} // namespace Orbane
