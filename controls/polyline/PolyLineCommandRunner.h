#pragma once

#include "orbane/OrbColor.h"
#include "orbane/Types.h"

#include <functional>
#include <string>

namespace Orbane {

class PolyLine;
class PolyLineControl;
class PreviewInfo;
class TagList;

// Runs one command of the polyline overlay's menu, toolbar or keys
// (PolyLineCommand with its argument) on the control. Commands that need a
// value a dialog would ask for (a colour, a file, a number) take it from
// PCA_CommandValue when a script sends them; from the window they open the
// dialog, which does not block the viewer. A command that cannot act tells
// the user why (PreviewControl::Tell) and answers false.
class PolyLineCommandRunner
{
public:
    PolyLineCommandRunner(PolyLineControl &control, PreviewInfo *info, const TagList *tags);
    bool Run(int32 command, int32 arg);

private:
    bool Mode(int32 command);
    bool Display(int32 command, int32 arg);
    bool Toggle(bool &flag);
    bool Convert(int32 command);
    bool Color(int32 command);
    bool ExportShape();
    bool ImportShape();
    bool Import(int32 command);
    bool Onion(int32 command);
    bool Roto(int32 command);
    bool Number(const char *what, int32 &field, int32 low, int32 high);
    bool NextKeyframe(int32 step);
    bool EditMultiplePolys();
    bool Editing(int32 command, int32 arg);
    // The editor's answer; it has told the user why where it refused.
    bool Edited(bool done);
    // Writes `shape` as one undo step named `undo`.
    bool Write(const char *undo, PolyLine *shape);
    bool Editable(const char *what);
    bool Tell(const std::string &message);
    // The value a script gave, or empty.
    std::string Value() const;
    bool FromScript() const;
    // Asks the user for a value with a dialog of the window; `done` gets it.
    void AskFile(bool save, const char *title, std::function<void(const std::string &)> done);
    void AskColor(OrbColor current, std::function<void(OrbColor)> done);

    PolyLineControl &mControl;
    PreviewInfo *mInfo;
    const TagList *mTags;
};

} // namespace Orbane
