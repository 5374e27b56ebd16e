#include "polyline/PolyPointDialog.h"

#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineShapes.h"

#include "orbane/PolyLine.h"

#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// Values nearer than this are shown as one (what a shape stores after a
// round trip through text).
constexpr float64 kSame = 1e-9;

constexpr const char *kNames[] = {"pointX", "pointY", "pointInX", "pointInY", "pointOutX", "pointOutY"};
constexpr const char *kLabels[] = {"X", "Y", "In handle X", "In handle Y", "Out handle X", "Out handle Y"};

std::array<float64, PolyPointDialog::FieldCount> ValuesOf(const PolyPoint &p)
{
    return {p.X, p.Y, p.InX - p.X, p.InY - p.Y, p.OutX - p.X, p.OutY - p.Y};
}

std::vector<uint8> SelectionBytes(const SelMask &sel)
{
    return std::vector<uint8>(sel.Bytes(), sel.Bytes() + sel.GetCount());
}

} // namespace

PolyPointDialog::PolyPointDialog(PolyLineControl &control, QWidget *parent)
    : QDialog(parent), mControl(control), mInfo(new QLabel(this))
{
    setObjectName("pointEditor");
    setWindowTitle(tr("Edit Point"));
    setModal(false);
    auto *form = new QFormLayout;
    for (int i = 0; i < FieldCount; ++i) {
        mFields[std::size_t(i)] = new QLineEdit(this);
        mFields[std::size_t(i)]->setObjectName(kNames[i]);
        form->addRow(tr(kLabels[i]), mFields[std::size_t(i)]);
        connect(mFields[std::size_t(i)], &QLineEdit::textEdited, this, [this] { mTyped = true; });
    }
    mInfo->setObjectName("pointInfo");
    mInfo->setWordWrap(true);
    auto *buttons =
        new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Apply | QDialogButtonBox::Close, this);
    buttons->button(QDialogButtonBox::Ok)->setObjectName("pointOk");
    buttons->button(QDialogButtonBox::Apply)->setObjectName("pointApply");
    buttons->button(QDialogButtonBox::Close)->setObjectName("pointClose");
    connect(buttons->button(QDialogButtonBox::Ok), &QPushButton::clicked, this, [this] {
        if (Apply())
            accept();
    });
    connect(buttons->button(QDialogButtonBox::Apply), &QPushButton::clicked, this, [this] { Apply(); });
    connect(buttons->button(QDialogButtonBox::Close), &QPushButton::clicked, this, &QDialog::reject);
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(mInfo);
    layout->addLayout(form);
    layout->addWidget(buttons);
    Load();
}

void PolyPointDialog::Load()
{
    mTyped = false;
    mLoadedShape = mControl.Shape();
    mLoadedSelection = SelectionBytes(mControl.Selection());
    std::vector<int32> chosen;
    for (int32 i = 0; mLoadedShape && i < mLoadedShape->GetCount() && i < int32(mLoadedSelection.size()); ++i)
        if (mLoadedSelection[std::size_t(i)])
            chosen.push_back(i);
    for (int f = 0; f < FieldCount; ++f) {
        QLineEdit *edit = mFields[std::size_t(f)];
        edit->setEnabled(!chosen.empty());
        edit->setPlaceholderText(chosen.size() > 1 ? tr("(differ)") : QString());
        bool shared = !chosen.empty();
        const float64 first = chosen.empty() ? 0.0 : ValuesOf(*mLoadedShape->GetPoint(chosen[0]))[std::size_t(f)];
        for (const int32 i : chosen)
            shared = shared && std::fabs(ValuesOf(*mLoadedShape->GetPoint(i))[std::size_t(f)] - first) < kSame;
        edit->setText(shared ? QString::number(first, 'g', 10) : QString());
    }
    mInfo->setText(chosen.empty()       ? tr("No point is selected")
                   : chosen.size() == 1 ? tr("Point %1").arg(chosen[0] + 1)
                                        : tr("%1 points").arg(chosen.size()));
}

void PolyPointDialog::Follow()
{
    if (mTyped)
        return;
    const AutoRef<PolyLine> shape = mControl.Shape();
    if (shape.get() != mLoadedShape.get() || SelectionBytes(mControl.Selection()) != mLoadedSelection)
        Load();
}

bool PolyPointDialog::Read(std::array<float64, FieldCount> &values, std::array<bool, FieldCount> &given)
{
    for (int f = 0; f < FieldCount; ++f) {
        const QString text = mFields[std::size_t(f)]->text().trimmed();
        given[std::size_t(f)] = !text.isEmpty();
        bool ok = true;
        values[std::size_t(f)] = given[std::size_t(f)] ? text.toDouble(&ok) : 0.0;
        if (!ok || !std::isfinite(values[std::size_t(f)])) {
            mInfo->setText(tr("%1: \"%2\" is not a number").arg(tr(kLabels[f]), text));
            return false;
        }
    }
    return true;
}

bool PolyPointDialog::Apply()
{
    std::array<float64, FieldCount> v{};
    std::array<bool, FieldCount> given{};
    if (!Read(v, given))
        return false;
    PolyLineEditor &editor = mControl.Editor();
    if (!editor.CanEdit() || mControl.Selection().GetSetCount() == 0) {
        mInfo->setText(editor.Message().empty() ? tr("No point is selected")
                                                : QString::fromStdString(editor.Message()));
        return false;
    }
    const std::vector<uint8> movable = PolyLineShapes::Movable(*mControl.Shape(), mControl.Selection());
    // The shape now takes the values; the other keys a multi-frame edit
    // reaches move their points by as much, keeping their own handles'
    // offsets where no handle value is given.
    std::vector<OrbPoint> moves(movable.size());
    bool first = true;
    auto edit = [&](PolyLine &s) {
        bool changed = false;
        for (int32 i = 0; i < s.GetCount() && i < int32(movable.size()); ++i) {
            if (!movable[std::size_t(i)])
                continue;
            const PolyPoint old = *s.GetPoint(i);
            std::array<float64, FieldCount> now = ValuesOf(old);
            if (first) {
                now[FX] = given[FX] ? v[FX] : old.X, now[FY] = given[FY] ? v[FY] : old.Y;
                moves[std::size_t(i)] = {now[FX] - old.X, now[FY] - old.Y};
            } else {
                now[FX] += moves[std::size_t(i)].x, now[FY] += moves[std::size_t(i)].y;
            }
            for (int f = FInX; f < FieldCount; ++f)
                now[std::size_t(f)] = given[std::size_t(f)] ? v[std::size_t(f)] : now[std::size_t(f)];
            PolyPoint p = old;
            p.X = now[FX], p.Y = now[FY];
            p.InX = p.X + now[FInX], p.InY = p.Y + now[FInY], p.OutX = p.X + now[FOutX], p.OutY = p.Y + now[FOutY];
            if (p.In() != p.Pos() || p.Out() != p.Pos())
                p.Flags &= ~uint32(PPF_Linear);
            changed = (p != old && s.SetPoint(i, p)) || changed;
        }
        first = false;
        return changed;
    };
    const bool done = std::any_of(movable.begin(), movable.end(), [](uint8 b) { return b != 0; })
                          ? editor.Commit("Edit Point", edit, false)
                          : false;
    mControl.ResetUndo(nullptr);
    mControl.Redraw();
    if (!done) {
        mInfo->setText(std::none_of(movable.begin(), movable.end(), [](uint8 b) { return b != 0; })
                           ? tr("The selected points are locked")
                           : QString::fromStdString(editor.Message()));
        return false;
    }
    Load();
    return true;
}

} // namespace Orbane
