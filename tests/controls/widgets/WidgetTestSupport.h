#pragma once

#include "orbane/InputControl.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QColor>

namespace Orbane {

// An input control that owns painted widgets in the tests: it counts what
// the widgets ask of it and, when given a document, reports Inputs that are
// not passive so that drags reach the document.
class TestOwner : public InputControl
{
public:
    TestOwner() : InputControl(nullptr, ScriptVal(), TagList()) {}

    bool UpdateDisplay(Input *, const TagList *) override
    {
        ++updateDisplays;
        return true;
    }
    void ResetUndo(const TagList *) override { ++resetUndos; }
    QColor GetBackgroundColor() const override { return background; }
    OrbaneDoc *GetDoc() const override { return doc; }
    bool AllInputsPassive() const override { return doc == nullptr; }

    int updateDisplays = 0;
    int resetUndos = 0;
    QColor background = QColor(51, 102, 153);
    OrbaneDoc *doc = nullptr;
};

} // namespace Orbane
