#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"
#include "widgets/Chromaticity.h"

class QComboBox;
class QLabel;

namespace Orbane {

class GamutDiagram;

// A colour space's gamut on the CIE 1931 xy diagram, on a ScriptVal Input:
//   { space = "Rec. 709", red = { x, y }, green = { x, y }, blue = { x, y }, white = { x, y } }
// A named space without points takes its published primaries; points given
// win, and a space whose points were dragged is "Custom". Children:
// "space", the list of spaces; "diagram", whose primaries and white point
// are dragged; "readout", the four points as numbers. The control has no
// tags of its own: everything is in the value. Each choice or drag is one
// undo step.
class ColorGamutControl : public LabelledInputControl
{
    Q_OBJECT
public:
    static constexpr const char *kCustom = "Custom";

    ColorGamutControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ColorGamutControl() override;

    std::size_t SizeOf() const override { return sizeof(ColorGamutControl); }

    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    // The gamut and space name a value holds; false (Rec. 709) where it is none.
    static bool Read(const ScriptVal &value, Chromaticity::Gamut &gamut, std::string &space);
    static ScriptVal ToScript(const Chromaticity::Gamut &gamut, const std::string &space);

private slots:
    void OnSpaceChosen(int index);
    void OnMoved(int index, float64 x, float64 y);
    void OnReleased();

private:
    void Take(const ScriptVal &value);
    void ShowValue();

    Chromaticity::Gamut mGamut;
    std::string mSpace;
    InputGesture mGesture;
    QComboBox *mSpaces;
    GamutDiagram *mDiagram;
    QLabel *mReadout;
};

} // namespace Orbane
