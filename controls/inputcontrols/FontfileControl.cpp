#include "inputcontrols/FontfileControl.h"

#include "framework/FontfileTags.h"
#include "framework/InputLink.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/LazyComboBox.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Text.h"

#include <QFontDatabase>
#include <QLabel>
#include <QSet>

#include <utility>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Fontfile.Layout";
constexpr const char *kDefaultPreview = "AaBbCc 0123";
constexpr int kPreviewPointSize = 13;

// The installed families, read when first asked for and freed by the
// registration's clean-up, as the angle and ellipse overlays keep their
// shapes: a plain pointer, because the clean-up may run at exit after the
// library's own statics are gone.
QSet<QString> *gFamilies = nullptr;

QString ToQString(const OrbString &s)
{
    return QString::fromStdString(s.str());
}

// Shows one row for `text` (filled later), marked where `missing`.
void ShowSingle(QComboBox *box, const QString &text, const QString &shown, bool missing)
{
    box->clear();
    box->addItem(shown, text);
    box->setProperty("missing", missing);
}

} // namespace

FontfileControl::FontfileControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mFamilies(new LazyComboBox(this)),
      mStyles(new LazyComboBox(this)), mPreview(new QLabel(this))
{
    mFamilies->setObjectName("family");
    mStyles->setObjectName("style");
    mPreview->setObjectName("preview");
    connect(mFamilies, SIGNAL(FillRequested()), this, SLOT(FillFamilies()));
    connect(mStyles, SIGNAL(FillRequested()), this, SLOT(FillStyles()));
    connect(mFamilies, SIGNAL(activated(int)), this, SLOT(OnFamily(int)));
    connect(mStyles, SIGNAL(activated(int)), this, SLOT(OnStyle(int)));
    RegisterChild("family", mFamilies);
    RegisterChild("style", mStyles);
    RegisterChild("preview", mPreview);
    Label()->setFocusProxy(mFamilies);
    AddAttr(FFC_ShowPreview, &mShowPreview, Attr_CopyAndList);
    ListAttr(FFCS_PreviewText, &mPreviewText);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

FontfileControl::~FontfileControl() = default;

bool FontfileControl::RegCleanup(Registry *reg)
{
    delete std::exchange(gFamilies, nullptr);
    return InputControl::RegCleanup(reg);
}

bool FontfileControl::IsInstalled(const QString &family)
{
    if (!gFamilies) {
        const QStringList all = QFontDatabase().families();
        gFamilies = new QSet<QString>(all.begin(), all.end());
    }
    return gFamilies->contains(family);
}

QString FontfileControl::StyleFor(const QString &family, const QString &style)
{
    const QStringList styles = QFontDatabase().styles(family);
    for (const QString &wanted : {style, QString("Regular"), QString("Normal")})
        if (styles.contains(wanted))
            return wanted;
    return styles.isEmpty() ? style : styles.first();
}

void FontfileControl::ReadOwnTags(const TagList &tags)
{
    const bool show = tags.GetBool(FFC_ShowPreview, mShowPreview);
    const OrbString text(tags.FindQuery(FFCS_PreviewText) ? tags.GetString(FFCS_PreviewText, "") : mPreviewText);
    if (show != mShowPreview || text != mPreviewText)
        MarkTextsChanged();
    mShowPreview = show;
    mPreviewText = text;
}

bool FontfileControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    if (LinkInput(*this, tags, FFCP_StyleInput, mStyleInput)) {
        const AutoText style(mStyleInput, GetCurrentTime());
        mStyle = style ? style->Value : OrbString();
        MarkTextsChanged();
    }
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool FontfileControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = !GetCurrentInput();
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (!first)
        return true;
    if (const AutoText now(input, GetCurrentTime()); now)
        mFamily = now->Value;
    if (LinkInput(*this, input->GetAttrs(), FFCP_StyleInput, mStyleInput))
        if (const AutoText style(mStyleInput, GetCurrentTime()); style)
            mStyle = style->Value;
    return true;
}

bool FontfileControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    Label()->show();
    mFamilies->show();
    ShowFont();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

bool FontfileControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    const auto *text = dynamic_cast<const Text *>(value);
    OrbString &field = input && input == mStyleInput ? mStyle : mFamily;
    if (!text || text->Value == field)
        return true;
    field = text->Value;
    MarkTextsChanged();
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

// A change of the font shows as the texts do: the rows are made again.
bool FontfileControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen() && TextsChanged())
        ShowFont();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void FontfileControl::ShowFont()
{
    const QString family = ToQString(mFamily), style = ToQString(mStyle);
    const bool missing = !family.isEmpty() && !IsInstalled(family);
    ShowSingle(mFamilies, family, missing ? family + " (not installed)" : family, missing);
    mFamilies->setToolTip(missing ? "Not installed: " + family : family);
    ShowSingle(mStyles, style, style, false);
    mStyles->setVisible(mStyleInput != nullptr);
    mPreview->setVisible(mShowPreview);
    if (missing || family.isEmpty()) {
        mPreview->setFont(GetControlFont());
        mPreview->setText(missing ? "Not installed: " + family : QString());
        return;
    }
    mPreview->setFont(QFontDatabase().font(family, style, kPreviewPointSize));
    mPreview->setText(mPreviewText.IsEmpty() ? kDefaultPreview : ToQString(mPreviewText));
}

void FontfileControl::FillFamilies()
{
    const QString family = ToQString(mFamily);
    const bool missing = mFamilies->property("missing").toBool();
    mFamilies->clear();
    // A family that is not here stays the first row, so the list shows it.
    if (missing)
        mFamilies->addItem(family + " (not installed)", family);
    for (const QString &name : QFontDatabase().families())
        mFamilies->addItem(name, name);
    mFamilies->setCurrentIndex(std::max(0, mFamilies->findData(family)));
}

void FontfileControl::FillStyles()
{
    const QString style = ToQString(mStyle);
    const QStringList styles = QFontDatabase().styles(ToQString(mFamily));
    mStyles->clear();
    if (!styles.contains(style))
        mStyles->addItem(style, style);
    for (const QString &name : styles)
        mStyles->addItem(name, name);
    mStyles->setCurrentIndex(std::max(0, mStyles->findData(style)));
}

// A new family keeps the style where it has it; both are one step.
void FontfileControl::OnFamily(int row)
{
    const QString family = mFamilies->itemData(row).toString();
    if (family == ToQString(mFamily))
        return;
    const AutoText familyText(OrbString(family.toStdString()));
    mGesture.Write(GetCurrentInput(), familyText, InputGesture::StepName(*this));
    if (mStyleInput) {
        const AutoText styleText(OrbString(StyleFor(family, ToQString(mStyle)).toStdString()));
        mGesture.Write(mStyleInput, styleText, InputGesture::StepName(*this));
    }
    mGesture.End();
}

void FontfileControl::OnStyle(int row)
{
    const QString style = mStyles->itemData(row).toString();
    if (style == ToQString(mStyle))
        return;
    const AutoText styleText(OrbString(style.toStdString()));
    mGesture.Write(mStyleInput, styleText, InputGesture::StepName(*this));
    mGesture.End();
}

bool FontfileControl::OnDisconnect(Input *input, const TagList *tags)
{
    WriteOnDisconnect(input, AutoText(input && input == mStyleInput ? mStyle : mFamily).get());
    const bool done = LabelledInputControl::OnDisconnect(input, tags);
    if (input == mStyleInput)
        mStyleInput = nullptr;
    return done;
}

} // namespace Orbane
