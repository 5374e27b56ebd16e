#pragma once

#include "orbane/InputControl.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptVal.h"
#include "orbane/TagList.h"

#include <QWidget>

#include <string>
#include <vector>

namespace Orbane {
namespace Test {

// A document with one tool whose Inputs a test declares, and inspector
// controls bound to them the way the inspector binds them: AddInput for each
// Input, SetAttrsTagList with the first Input's attributes, Open on a shown
// page, SetSize at a width. Controls are unbound (OnDisconnect) and released
// before the document goes.
class ToolFixture
{
public:
    explicit ToolFixture(const char *toolName = "Tool1");
    ~ToolFixture();
    ToolFixture(const ToolFixture &) = delete;
    ToolFixture &operator=(const ToolFixture &) = delete;

    Input *AddNumber(const char *id, float64 value, const TagList &attrs = TagList());
    Input *AddPoint(const char *id, float64 x, float64 y, const TagList &attrs = TagList());
    // A script-table Input, and its value at the document's time (nil where none).
    Input *AddTable(const char *id, const ScriptVal &value, const TagList &attrs = TagList());
    ScriptVal TableOf(const Input *input) const;

    // Adopts the control's reference and binds it to `inputs`; null stays null.
    InputControl *Bind(InputControl *control, const std::vector<Input *> &inputs, int32 width = kWidth);
    // Creates a registered class through ClassRegistry, with the first
    // Input's attributes as creation tags, and binds it.
    InputControl *Create(const OrbID &classID, const std::vector<Input *> &inputs, int32 width = kWidth);
    // SetSize at `width`; the control's new height.
    int32 Resize(InputControl *control, int32 width);
    // Unbinds and releases one control early (the disconnect tests).
    void Destroy(InputControl *control);

    // The control library as the host loads it: dlopen of ORBANE_CONTROLS
    // with RTLD_NOW | RTLD_GLOBAL, once per process.
    static bool LoadControls(std::string *error);
    // How often the loaded control library read the class layout item
    // `itemName` from the look pack; -1 where the library is not loaded.
    static int32 LayoutReadCount(const char *itemName);
    // A press on `w`, moves by `steps` pixels sideways with the left button
    // held, and the release where the last move ended, all with `mods`.
    static void DragSideways(QWidget *w, const std::vector<int32> &steps, Qt::KeyboardModifiers mods);
    // Current value of a Number Input at the document's time.
    float64 NumberOf(const Input *input) const;

    static constexpr int32 kWidth = 320;

    OrbaneDoc doc;
    Operator *tool = nullptr; // owned by the document
    QWidget page;

private:
    void Place();

    std::vector<InputControl *> mControls; // one reference each
};

} // namespace Test
} // namespace Orbane
