#pragma once

#include "orbane/AutoRef.h"
#include "orbane/Types.h"

#include <QDialog>

#include <array>
#include <vector>

class QLabel;
class QLineEdit;

namespace Orbane {

class PolyLine;
class PolyLineControl;

// The point editor ("Edit Point", key E): the exact position of the
// selected points and their handles. X and Y are image coordinates (0..1
// across each axis, Y up, as scripts give them); the handles are offsets
// from their point, so moving a point carries its handles and one offset
// can be shared by several points. With several points selected, a field
// shows the value they share and is blank where they differ; a blank field
// leaves each point its own value. OK and Apply write every selected point
// (locked ones excepted) as one undo step, "Edit Point".
//
// The editor follows the selection and the shape until the user types in
// it. Its parts, by object name: "pointEditor" (the dialog), "pointX",
// "pointY", "pointInX", "pointInY", "pointOutX", "pointOutY", "pointInfo"
// (which points, or why Apply did nothing), "pointOk", "pointApply",
// "pointClose".
class PolyPointDialog : public QDialog
{
public:
    enum FieldIndex
    {
        FX,
        FY,
        FInX,
        FInY,
        FOutX,
        FOutY,
        FieldCount
    };

    PolyPointDialog(PolyLineControl &control, QWidget *parent);

    // Shows the selection now, dropping anything typed.
    void Load();
    // Loads again where the selection or the shape changed since, unless
    // the user has typed.
    void Follow();
    // Writes the fields to the selected points; false (and why in the
    // info line) where nothing was written.
    bool Apply();

private:
    bool Read(std::array<float64, FieldCount> &values, std::array<bool, FieldCount> &given);

    PolyLineControl &mControl;
    std::array<QLineEdit *, FieldCount> mFields{};
    QLabel *mInfo;
    bool mTyped = false;
    AutoRef<PolyLine> mLoadedShape;
    std::vector<uint8> mLoadedSelection;
};

} // namespace Orbane
