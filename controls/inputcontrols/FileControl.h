#pragma once

#include "framework/LabelledInputControl.h"

#include "orbane/OrbString.h"

namespace Orbane {

class PathChooser;

// Shows a Text Input that holds a file path: a label, the path in an edit
// box and a browse button; a file dropped on the control is taken too. A
// path that is not on disk is marked (for a file to save, only a missing
// folder is). Paths may be kept relative to the comp's folder.
class FileControl : public LabelledInputControl
{
    Q_OBJECT
public:
    FileControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~FileControl() override;

    std::size_t SizeOf() const override { return sizeof(FileControl); }

    using InputControl::SetAttrsTagList;
    bool SetAttrsTagList(Input *input, const TagList &tags) override;
    bool AddInput(Input *input, const TagList *tags) override;
    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    // Why `path` (absolute) counts as missing for a control of these
    // settings, or empty where it is there.
    static QString MissingReason(const QString &path, bool save, bool folder);

private slots:
    void OnChosen(const QString &path);

private:
    void ReadOwnTags(const TagList &tags);
    void ShowPath();

    OrbString mPath;
    bool mSave = false;
    bool mDirectory = false;
    bool mRelative = false;
    OrbString mFilter;
    PathChooser *mChooser;
};

} // namespace Orbane
