#pragma once

#include "orbane/Types.h"

#include <QPointer>
#include <QScrollArea>

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
class ParameterPanel : public QScrollArea
{
    Q_OBJECT
public:
    explicit ParameterPanel(OrbaneDoc *doc, QWidget *parent = nullptr);
    ~ParameterPanel() override;

    void ShowTool(Operator *tool);
    Operator *GetTool() const { return mTool; }

    // The controls of an Input, in creation order.
    std::vector<InputControl *> ControlsOf(const Input *input) const;
    const std::vector<InputControl *> &Controls() const { return mControls; }

signals:
    void toolShown(Orbane::Operator *tool);

protected:
    void resizeEvent(QResizeEvent *event) override;

private slots:
    void OnToolRemoving(Orbane::Operator *tool);

private:
    InputControl *CreateControl(Input *input, const char *classID);
    void Clear();
    void LayOut();

    OrbaneDoc *mDoc;
    Operator *mTool = nullptr;
    std::vector<InputControl *> mControls; // one reference each
    int32 mLaidOutWidth = -1;
};

} // namespace Orbane
