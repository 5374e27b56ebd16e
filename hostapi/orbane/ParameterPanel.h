#pragma once

#include "orbane/OrbID.h"
#include "orbane/Types.h"

#include <QPointer>
#include <QScrollArea>

#include <map>
#include <vector>

namespace Orbane {

class Input;
class InputControl;
class Operator;
class OrbaneDoc;

// The inspector: shows one tool's controls, top to bottom in Input order. For each Input it
// creates the control classes the Input names (INPA_InputControl) through the
// class registry and drives each control through AddInput, SetAttrsTagList,
// Open and SetSize; a width change sizes every control again. When the tool
// leaves the document, or another tool is shown, each control is unbound
// (OnDisconnect) and destroyed.
//
// Controls are built in Input order as far as the view needs them: the first
// screens' worth (and at least kFirstBuilt) when the tool is shown, more as the
// view scrolls towards them, and all up to an Input whose controls are asked
// for. A tool of thousands of Inputs thus shows at once; the page keeps the
// height the unbuilt rest is estimated to take, so the scroll bar is right.
class ParameterPanel : public QScrollArea
{
    Q_OBJECT
public:
    // Controls built when a tool is shown, whatever the view's height.
    static constexpr size_t kFirstBuilt = 100;

    explicit ParameterPanel(OrbaneDoc *doc, QWidget *parent = nullptr);
    ~ParameterPanel() override;

    void ShowTool(Operator *tool);
    Operator *GetTool() const { return mTool; }

    // The controls of an Input, in creation order; builds them, and those of
    // every Input before it, where they are not built yet.
    std::vector<InputControl *> ControlsOf(const Input *input);
    // The controls built so far, in Input order.
    const std::vector<InputControl *> &Controls() const { return mControls; }
    // How many controls the shown tool has, built or not.
    size_t ControlCount() const { return mSlots.size(); }

    // Folding: a group header hides the rows of the Inputs under it, and
    // the rows below move up at once. Each closed header that covers an
    // Input counts once, so a row shows again only when no header hides it
    // (an open inner group inside a closed outer one stays hidden). A row
    // not built yet is built hidden. Calls must come in pairs per header.
    void HideInputs(const std::vector<Input *> &inputs, bool hide);
    bool IsInputHidden(const Input *input) const;
    // The inspector that shows `control`, or null where it is in none.
    static ParameterPanel *Of(const QWidget *control);

signals:
    void toolShown(Orbane::Operator *tool);

protected:
    void resizeEvent(QResizeEvent *event) override;

private slots:
    void OnToolRemoving(Orbane::Operator *tool);
    void OnScrolled(int value);

private:
    // A control to build: the Input and the class it names.
    struct Slot
    {
        Input *input;
        OrbID classID;
    };

    InputControl *CreateControl(Input *input, const char *classID, QWidget *page);
    void BuildUntil(QWidget *page, int32 bottom, size_t count);
    void BuildThrough(size_t count);
    void PredictWidth();
    void Place(InputControl *control, int32 inner);
    int32 InnerWidth() const;
    void ResizePage();
    void Clear();
    void LayOut();
    void Reflow();

    OrbaneDoc *mDoc;
    Operator *mTool = nullptr;
    std::vector<Slot> mSlots;              // every control of the tool, in order
    std::vector<InputControl *> mControls; // the built ones, one reference each
    int32 mLaidOutWidth = -1;
    int32 mBuiltBottom = 0; // where the next built control goes
    bool mBuilding = false;
    std::map<const Input *, int32> mHiddenBy; // closed headers hiding each Input
};

} // namespace Orbane
