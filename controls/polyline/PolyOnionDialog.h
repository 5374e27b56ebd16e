#pragma once

#include <QDialog>

class QCheckBox;
class QFormLayout;
class QLabel;
class QLineEdit;

namespace Orbane {

class PolyLineControl;
struct PolyLineSettings;

// The onion-skin settings ("Onion skin settings…"): whether skins show, how
// many keyframes before and after the current time show one, their colour
// and opacity, the colour of the skins before now, and their dot pattern.
// A change shows at once (Return or leaving a field applies it). These are
// settings of the view, like the draw style, so they make no undo step.
//
// Parts, by object name: "onionDialog", "onionEnabled" (a check box),
// "onionBefore", "onionAfter" (0 to 100), "onionColor" ("#rrggbb"),
// "onionOpacity" (0 to 100 percent), "onionPrevColor" ("#rrggbb"; blank:
// the skins' colour), "onionStipple" (16 bits in hex, "FFFF" solid),
// "onionInfo" (why a value was not taken), "onionClose".
class PolyOnionDialog : public QDialog
{
public:
    PolyOnionDialog(PolyLineControl &control, PolyLineSettings &settings, QWidget *parent);

    // Shows the settings as they are now.
    void Load();

private:
    QLineEdit *AddField(QFormLayout *form, const char *label, const char *name);
    // Takes the field's text into the settings; false (and the field shows
    // the setting again) where it is not a value of the field.
    bool Take(QLineEdit *field);
    void Changed();

    PolyLineControl &mControl;
    PolyLineSettings &mSettings;
    QCheckBox *mEnabled;
    QLineEdit *mBefore, *mAfter, *mColor, *mOpacity, *mPrevColor, *mStipple;
    QLabel *mInfo;
};

} // namespace Orbane
