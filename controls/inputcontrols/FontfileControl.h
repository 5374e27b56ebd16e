#pragma once

#include "framework/InputGesture.h"
#include "framework/LabelledInputControl.h"

#include "orbane/OrbString.h"

class QLabel;

namespace Orbane {

class LazyComboBox;

// Chooses a font from those installed (Qt's font database): the Text Input
// it stands on holds the family, and a further Text Input, given by
// FFCP_StyleInput, the style ("Bold Italic"). The family list ("family")
// and the style list ("style") are filled when opened; a line of text under
// them ("preview") shows the choice. A family that is not installed stays
// shown, marked, and keeps its style, so a comp from another machine reads
// right and is not rewritten.
class FontfileControl : public LabelledInputControl
{
    Q_OBJECT
public:
    FontfileControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~FontfileControl() override;

    std::size_t SizeOf() const override { return sizeof(FontfileControl); }

    // Frees the class's list of installed families, then the family's clean-up.
    static bool RegCleanup(Registry *reg);
    // Is `family` installed? Asked of a list read once per process.
    static bool IsInstalled(const QString &family);
    // The style a family change keeps: `style` where the family has it,
    // else "Regular", "Normal" or the first it has.
    static QString StyleFor(const QString &family, const QString &style);

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

private slots:
    void FillFamilies();
    void FillStyles();
    void OnFamily(int row);
    void OnStyle(int row);

private:
    void ReadOwnTags(const TagList &tags);
    void ShowFont();

    OrbString mFamily;
    OrbString mStyle;
    OrbString mPreviewText;
    bool mShowPreview = true;
    Input *mStyleInput = nullptr;
    InputGesture mGesture;
    LazyComboBox *mFamilies;
    LazyComboBox *mStyles;
    QLabel *mPreview;
};

} // namespace Orbane
