#pragma once

#include "inputcontrols/CCPickButton.h"

#include "orbane/Tags.h"

#include <array>
#include <bitset>
#include <vector>

namespace Orbane {

class Input;
class InputControl;
class ScriptObject;

// A pick button that puts its owner's tool back as it was when a pick fails.
// At the start of a pick it saves, for every Number Input of the owner's
// tool whose attribute PBA_SaveIndex holds an index from 0 to 31, the
// Input's value at the owner's current time; a pick released over no widget
// of the application writes the saved values back (flags 1: no undo record,
// the tool only returns to where it was).
class PickButton : public CCPickButton
{
    Q_OBJECT
public:
    static constexpr Tag PBA_SaveIndex = 0x10030007;
    static constexpr int32 kSlots = 32;

    explicit PickButton(QWidget *parent = nullptr);
    ~PickButton() override;

    void SetOwner(InputControl *owner) { mOwner = owner; }
    InputControl *GetOwner() const { return mOwner; }
    // Holds one reference to an object of the picking owner's choice.
    void Attach(ScriptObject *object);
    ScriptObject *GetAttached() const { return mAttached; }

    // Returns how many Inputs were saved or restored.
    int32 SaveValues();
    int32 RestoreValues();
    float64 SavedValue(int32 index) const;

protected:
    void PickStarted() override;
    void PickFinished(QWidget *target, const QPoint &pos) override;

private:
    // The slot of a Number Input that takes part, or -1.
    static int32 SlotOf(const Input *input);
    std::vector<Input *> OwnerInputs() const;

    InputControl *mOwner = nullptr;
    std::array<float64, kSlots> mSaved{};
    std::bitset<kSlots> mHaveSaved;
    ScriptObject *mAttached = nullptr;
};

} // namespace Orbane
