#include "polyline/PolyOnionDialog.h"

#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineSettings.h"

#include <QCheckBox>
#include <QColor>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QVBoxLayout>

#include <cmath>

namespace Orbane {

namespace {

constexpr int kMaxSkins = 100;

QString HexOf(OrbColor c)
{
    return c.IsNone() ? QString() : QColor(c.R(), c.G(), c.B()).name();
}

// "#rrggbb" only: the opacity has a field of its own.
bool ColorOf(const QString &text, OrbColor &out)
{
    const QColor q(text);
    if (!q.isValid() || text.size() != 7 || !text.startsWith('#'))
        return false;
    out = OrbColor(uint8(q.red()), uint8(q.green()), uint8(q.blue()), out.IsNone() ? 255 : out.A());
    return true;
}

} // namespace

PolyOnionDialog::PolyOnionDialog(PolyLineControl &control, PolyLineSettings &settings, QWidget *parent)
    : QDialog(parent), mControl(control), mSettings(settings), mEnabled(new QCheckBox(tr("Show onion skins"), this)),
      mInfo(new QLabel(this))
{
    setObjectName("onionDialog");
    setWindowTitle(tr("Onion Skin Settings"));
    setModal(false);
    mEnabled->setObjectName("onionEnabled");
    auto *form = new QFormLayout;
    form->addRow(mEnabled);
    mBefore = AddField(form, "Keyframes before", "onionBefore");
    mAfter = AddField(form, "Keyframes after", "onionAfter");
    mColor = AddField(form, "Colour", "onionColor");
    mOpacity = AddField(form, "Opacity %", "onionOpacity");
    mPrevColor = AddField(form, "Colour before now", "onionPrevColor");
    mStipple = AddField(form, "Dots (hex)", "onionStipple");
    mInfo->setObjectName("onionInfo");
    mInfo->setWordWrap(true);
    auto *buttons = new QDialogButtonBox(QDialogButtonBox::Close, this);
    buttons->button(QDialogButtonBox::Close)->setObjectName("onionClose");
    buttons->button(QDialogButtonBox::Close)->setAutoDefault(false);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    connect(mEnabled, &QCheckBox::toggled, this, [this](bool on) {
        mSettings.onionEnabled = on;
        Changed();
    });
    auto *layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addWidget(mInfo);
    layout->addWidget(buttons);
    Load();
}

QLineEdit *PolyOnionDialog::AddField(QFormLayout *form, const char *label, const char *name)
{
    auto *edit = new QLineEdit(this);
    edit->setObjectName(name);
    form->addRow(tr(label), edit);
    connect(edit, &QLineEdit::editingFinished, this, [this, edit] {
        if (edit->isModified() && Take(edit))
            Changed();
        edit->setModified(false);
    });
    return edit;
}

void PolyOnionDialog::Load()
{
    const QSignalBlocker block(mEnabled);
    mEnabled->setChecked(mSettings.onionEnabled);
    mBefore->setText(QString::number(mSettings.onionBefore));
    mAfter->setText(QString::number(mSettings.onionAfter));
    mColor->setText(HexOf(mSettings.onionColor));
    mOpacity->setText(QString::number(std::lround(mSettings.onionColor.A() * 100.0 / 255.0)));
    mPrevColor->setText(HexOf(mSettings.onionPrevColor));
    mStipple->setText(QString("%1").arg(mSettings.onionStipple, 4, 16, QChar('0')).toUpper());
}

bool PolyOnionDialog::Take(QLineEdit *field)
{
    const QString text = field->text().trimmed();
    bool ok = false;
    QString why;
    if (field == mBefore || field == mAfter) {
        const int n = text.toInt(&ok);
        ok = ok && n >= 0 && n <= kMaxSkins;
        if (ok)
            (field == mBefore ? mSettings.onionBefore : mSettings.onionAfter) = n;
        why = tr("give a whole number from 0 to %1").arg(kMaxSkins);
    } else if (field == mColor) {
        ok = ColorOf(text, mSettings.onionColor);
        why = tr("give the colour as #rrggbb");
    } else if (field == mOpacity) {
        const double percent = text.toDouble(&ok);
        ok = ok && percent >= 0.0 && percent <= 100.0;
        if (ok)
            mSettings.onionColor = OrbColor(mSettings.onionColor.R(), mSettings.onionColor.G(),
                                            mSettings.onionColor.B(), uint8(std::lround(percent * 2.55)));
        why = tr("give a percentage from 0 to 100");
    } else if (field == mPrevColor) {
        OrbColor prev(255, 255, 255, 255);
        ok = text.isEmpty() || ColorOf(text, prev);
        if (ok)
            mSettings.onionPrevColor = text.isEmpty() ? OrbColor() : prev;
        why = tr("give the colour as #rrggbb, or leave it blank for the skins' colour");
    } else {
        const uint pattern = text.toUInt(&ok, 16);
        ok = ok && pattern > 0 && pattern <= 0xFFFF;
        if (ok)
            mSettings.onionStipple = uint16(pattern);
        why = tr("give 1 to 4 hex digits, not all 0 (FFFF is solid)");
    }
    mInfo->setText(ok ? QString() : QString("%1: %2").arg(field->objectName(), why));
    Load();
    return ok;
}

void PolyOnionDialog::Changed()
{
    mControl.Redraw();
}

} // namespace Orbane
