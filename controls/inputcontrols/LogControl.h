#pragma once

#include "inputcontrols/TableInputControl.h"
#include "widgets/TransferFunctions.h"

#include <array>

class QLabel;

namespace Orbane {

class CurveGraph;
class TimeCodeEdit;

// Log-to-linear conversion settings in one script-table Input: { black =
// 95, white = 685, filmGamma = 0.6, softClip = 0 } (a key left out takes
// that default). Each is typed in its box ("black", "white", "gamma",
// "softclip"), one undo step each; the graph ("graph") draws the
// conversion over the code values 0..1023, with the clip at 1 dashed.
class LogControl : public TableInputControl
{
    Q_OBJECT
public:
    LogControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~LogControl() override;

    std::size_t SizeOf() const override { return sizeof(LogControl); }

    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;

    // The settings of a value table; keys left out, or not numbers, take
    // the defaults, and the result is tidied.
    static TransferFunctions::LogSettings SettingsOf(const ScriptVal &table);
    static ScriptVal TableOf(const TransferFunctions::LogSettings &settings);

protected:
    void ShowValue() override;

private slots:
    void OnTyped();

private:
    std::array<TimeCodeEdit *, 4> mEdits;
    std::array<QLabel *, 4> mCaptions;
    CurveGraph *mGraph;
};

} // namespace Orbane
