#pragma once

#include "orbane/ScriptVal.h"

#include <QTreeWidget>

namespace Orbane {

// A read-only tree of a script table: keys in column 0, values in column 1.
// A table value with a structure of its own (several named keys, or a table
// among its values) becomes child rows, one level deep; any other table, and
// every table below that level, reads inline as "{ a = 1, 2, <subtable> }".
// The standard Copy key puts the selected rows on the clipboard as lines of
// tab-separated cells, ready to paste into a spreadsheet.
class ScriptValTreeWidget : public QTreeWidget
{
    Q_OBJECT
public:
    explicit ScriptValTreeWidget(QWidget *parent = nullptr);
    ~ScriptValTreeWidget() override;

    // Adds a row under `parent` for each entry of `table`, in the table's
    // order; `nested` rows summarise their tables instead of growing children.
    void Fill(QTreeWidgetItem *parent, const ScriptVal &table, bool nested);
    // The selected cells, range by range, a row a line, cells joined by tabs.
    QString SelectedText() const;

    // A key as its row shows it: a string as it is, others as a script prints them.
    static QString KeyText(const ScriptVal &key);
    // A number, string or boolean as its row shows it; empty for other types.
    static QString PlainText(const ScriptVal &value);
    // "{ a = 1, 2, <subtable> }"; an empty table reads "{  }".
    static QString Summary(const ScriptVal &table);
    // Does a table at the top level get child rows rather than a summary?
    static bool HasStructure(const ScriptVal &table, const ScriptVal &parent);

protected:
    void keyPressEvent(QKeyEvent *event) override;
};

} // namespace Orbane
