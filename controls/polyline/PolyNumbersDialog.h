#pragma once

#include "orbane/Types.h"

#include <QDialog>

#include <functional>
#include <string>
#include <vector>

class QLabel;
class QLineEdit;

namespace Orbane {

// A small dialog of named numbers with OK and Cancel: the editors of the
// polyline overlay that ask for a few values (a rectangle's or an ellipse's
// size, the reduce tolerance, smoothing and easing amounts). It is not
// modal: the viewer stays usable while it is open.
//
// Every part has an object name, so scripts fill it as a person would:
// the fields by their own names, "numbersOk", "numbersCancel" and
// "numbersMessage" (why OK did nothing). Return in a field presses OK.
class PolyNumbersDialog : public QDialog
{
public:
    struct Field
    {
        const char *label; // "Width"
        const char *name;  // the field's object name
        float64 value;     // what it shows at first
        float64 low, high; // the values it takes
        bool whole;        // whole numbers only
    };
    // Takes the values, in field order; answers why it refused (the
    // dialog then stays open and shows it), or "" when done.
    using Done = std::function<std::string(const std::vector<float64> &)>;

    PolyNumbersDialog(QWidget *parent, const QString &title, const QString &objectName, std::vector<Field> fields,
                      Done done);

    // Reads numbers in field order from `text` (a script's value: numbers
    // apart by spaces or commas; fewer keep the fields' own values). False
    // with the reason in `why` for a word that is no number or one out of
    // its field's range.
    static bool Parse(const std::vector<Field> &fields, const std::string &text, std::vector<float64> &values,
                      std::string &why);
    // Checks one value against its field; the reason where it does not fit.
    static std::string Check(const Field &field, float64 value);

private:
    void Accept();

    std::vector<Field> mFields;
    std::vector<QLineEdit *> mEdits;
    QLabel *mMessage;
    Done mDone;
};

} // namespace Orbane
