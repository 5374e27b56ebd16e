#include "inputcontrols/ClipControl.h"

#include "framework/ClipTags.h"
#include "framework/InputLink.h"
#include "inputcontrols/DisconnectWrite.h"
#include "inputcontrols/PathChooser.h"

#include "orbane/AutoParam.h"
#include "orbane/ElideLabel.h"
#include "orbane/Text.h"

#include <QLabel>
#include <QLineEdit>
#include <QSignalBlocker>
#include <QSpinBox>
#include <QToolButton>

#include <cmath>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.Clip.Layout";

QSpinBox *MakeFrameBox(QWidget *owner, const char *name, const char *tip)
{
    auto *box = new QSpinBox(owner);
    box->setObjectName(name);
    box->setToolTip(tip);
    // A typed frame is one edit, not one per keystroke.
    box->setKeyboardTracking(false);
    box->setRange(-1000000, 1000000);
    return box;
}

int32 FrameOf(const Parameter *value, int32 current)
{
    const auto *number = dynamic_cast<const Number *>(value);
    return number ? int32(std::floor(number->Value + 0.5)) : current;
}

} // namespace

ClipControl::ClipControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : LabelledInputControl(reg, args, tags), mGesture(*this), mChooser(new PathChooser(this)), mFrames(new QLabel(this))
{
    mFrames->setObjectName("frames");
    connect(mChooser, SIGNAL(Chosen(QString)), this, SLOT(OnChosen(QString)));
    RegisterChild("edit", mChooser->Edit());
    RegisterChild("browse", mChooser->Browse());
    RegisterChild("frames", mFrames);
    Label()->setFocusProxy(mChooser->Edit());
    ListAttr(CLCS_Filter, &mFilter);
    ReadOwnTags(tags);
    ClassLayout(kLayoutItem);
}

ClipControl::~ClipControl() = default;

void ClipControl::ReadOwnTags(const TagList &tags)
{
    if (tags.FindQuery(CLCS_Filter))
        mFilter = OrbString(tags.GetString(CLCS_Filter, ""));
    mChooser->SetFilter(QString::fromStdString(mFilter.str()));
}

void ClipControl::LinkTrimInputs(const TagList &tags)
{
    const bool in = LinkInput(*this, tags, CLCP_InInput, mInInput);
    const bool out = LinkInput(*this, tags, CLCP_OutInput, mOutInput);
    // Trims linked once the control is open need their boxes placed.
    if ((in || out) && IsOpen() && MakeTrimBoxes())
        PlaceChildren(ClassLayout(kLayoutItem), false);
    if (in || out)
        ReadTrims();
}

// The boxes are made only for a clip with trim Inputs: a spin box costs as
// much to build as the rest of the control.
bool ClipControl::MakeTrimBoxes()
{
    if (mInBox || (!mInInput && !mOutInput))
        return false;
    mInBox = MakeFrameBox(this, "in", "First frame used");
    mOutBox = MakeFrameBox(this, "out", "Last frame used");
    connect(mInBox, SIGNAL(valueChanged(int)), this, SLOT(OnIn(int)));
    connect(mOutBox, SIGNAL(valueChanged(int)), this, SLOT(OnOut(int)));
    RegisterChild("in", mInBox);
    RegisterChild("out", mOutBox);
    return true;
}

void ClipControl::ReadTrims()
{
    mIn = FrameOf(AutoNumber(mInInput, GetCurrentTime()).get(), mIn);
    mOut = FrameOf(AutoNumber(mOutInput, GetCurrentTime()).get(), mOut);
    if (IsOpen())
        ShowTrims();
}

bool ClipControl::SetAttrsTagList(Input *input, const TagList &tags)
{
    ReadOwnTags(tags);
    LinkTrimInputs(tags);
    return LabelledInputControl::SetAttrsTagList(input, tags);
}

bool ClipControl::AddInput(Input *input, const TagList *tags)
{
    const bool first = !GetCurrentInput();
    if (!LabelledInputControl::AddInput(input, tags))
        return false;
    if (!first)
        return true;
    if (const AutoText now(input, GetCurrentTime()); now)
        mPath = now->Value;
    LinkTrimInputs(input->GetAttrs());
    return true;
}

bool ClipControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!LabelledInputControl::Open(host, rect, tags))
        return false;
    for (QWidget *child : {static_cast<QWidget *>(Label()), static_cast<QWidget *>(mChooser->Edit()),
                           static_cast<QWidget *>(mChooser->Browse()), static_cast<QWidget *>(mFrames)})
        child->show();
    MakeTrimBoxes();
    ShowClip();
    PlaceChildren(ClassLayout(kLayoutItem), false);
    return true;
}

bool ClipControl::NotifyChanged(Input *input, Parameter *value, const TagList *tags)
{
    if (!value)
        return LabelledInputControl::NotifyChanged(input, value, tags);
    if (input && (input == mInInput || input == mOutInput)) {
        int32 &frame = input == mInInput ? mIn : mOut;
        const int32 now = FrameOf(value, frame);
        if (now == frame)
            return true;
        frame = now;
    } else {
        const auto *text = dynamic_cast<const Text *>(value);
        if (!text || text->Value == mPath)
            return true;
        mPath = text->Value;
        mDetected = false;
    }
    return LabelledInputControl::NotifyChanged(input, value, tags);
}

bool ClipControl::UpdateDisplay(Input *input, const TagList *tags)
{
    if (IsOpen())
        ShowClip();
    return LabelledInputControl::UpdateDisplay(input, tags);
}

void ClipControl::Detect()
{
    if (mDetected)
        return;
    const QString path = QString::fromStdString(mPath.str());
    mClip = path.isEmpty() ? ClipSequence()
                           : ClipSequence::Detect(PathChooser::Resolve(path, PathChooser::CompFolder(GetDoc())));
    mDetected = true;
}

void ClipControl::ShowClip()
{
    Detect();
    const QString path = QString::fromStdString(mPath.str());
    const bool missing = !path.isEmpty() && mClip.IsEmpty();
    mChooser->Show(path, missing, missing ? "No frames found: " + path : QString());
    mFrames->setText(path.isEmpty() ? QString() : mClip.Describe());
    mFrames->setProperty("missing", missing);
    ShowTrims();
}

// The boxes bound each other and the frames found; a trim outside them
// (frames removed from disk since) is shown as it is, not rewritten.
void ClipControl::ShowTrims()
{
    if (!mInBox)
        return;
    const bool trims = mClip.IsSequence() && !mClip.IsEmpty();
    const QSignalBlocker blockIn(mInBox), blockOut(mOutBox);
    mInBox->setVisible(mInInput && trims);
    mOutBox->setVisible(mOutInput && trims);
    mInBox->setRange(std::min(mClip.first, mIn), std::max(mIn, std::min(mOut, mClip.last)));
    mOutBox->setRange(std::min(mOut, std::max(mIn, mClip.first)), std::max(mClip.last, mOut));
    mInBox->setValue(mIn);
    mOutBox->setValue(mOut);
}

bool ClipControl::WriteFrame(Input *input, int32 frame)
{
    const AutoNumber number{float64(frame)};
    return mGesture.Write(input, number, InputGesture::StepName(*this));
}

void ClipControl::OnChosen(const QString &path)
{
    const ClipSequence clip = ClipSequence::Detect(PathChooser::Resolve(path, PathChooser::CompFolder(GetDoc())));
    const QString stored = clip.IsSequence() && !clip.IsEmpty() ? clip.pattern : path;
    const AutoText text(OrbString(stored.toStdString()));
    mGesture.Write(GetCurrentInput(), text, InputGesture::StepName(*this));
    if (clip.IsSequence() && !clip.IsEmpty()) {
        WriteFrame(mInInput, clip.first);
        WriteFrame(mOutInput, clip.last);
    }
    mGesture.End();
    ShowClip();
}

void ClipControl::OnIn(int frame)
{
    WriteFrame(mInInput, frame);
    mGesture.End();
    ShowTrims();
}

void ClipControl::OnOut(int frame)
{
    WriteFrame(mOutInput, frame);
    mGesture.End();
    ShowTrims();
}

bool ClipControl::OnDisconnect(Input *input, const TagList *tags)
{
    if (input && input == mInInput)
        WriteOnDisconnect(input, float64(mIn));
    else if (input && input == mOutInput)
        WriteOnDisconnect(input, float64(mOut));
    else
        WriteOnDisconnect(input, AutoText(mPath).get());
    const bool done = LabelledInputControl::OnDisconnect(input, tags);
    if (input == mInInput)
        mInInput = nullptr;
    if (input == mOutInput)
        mOutInput = nullptr;
    return done;
}

} // namespace Orbane
