#pragma once

#include "orbane/Types.h"

#include <QDialog>

#include <vector>

class QLabel;
class QListWidget;

namespace Orbane {

class PolyLineControl;

// The keyframe list of an animated shape ("Polygon Keyframe List..."): one
// row per keyframe, earliest first, the one at the current time marked.
// "Go To" (or a double click on a row) sets the document's time to the
// chosen key; "Delete" removes the chosen keys as one undo step, "Delete
// Keyframes" (all of them: the animation ends, the shape shown now stays).
// The list follows the keys as they change.
//
// Parts, by object name: "polyKeyList" (the dialog), "keyList" (the rows:
// click with `row = n`, Shift or Ctrl to choose several), "keyInfo" (how
// many keys, or why a button did nothing), "keyJump", "keyDelete",
// "keyClose".
class PolyKeyListDlg : public QDialog
{
public:
    PolyKeyListDlg(PolyLineControl &control, QWidget *parent);

    // Fills the rows from the keys now, keeping the chosen ones chosen.
    void Refresh();
    std::vector<float64> Chosen() const;
    bool JumpToChosen();
    bool DeleteChosen();

private:
    void Say(const QString &why);

    PolyLineControl &mControl;
    QListWidget *mList;
    QLabel *mInfo;
    std::vector<float64> mShown; // the key times the rows show
    float64 mShownTime = 0.0;
};

} // namespace Orbane
