#include "inputcontrols/ScriptValTreeWidget.h"

#include <QApplication>
#include <QClipboard>
#include <QKeyEvent>

#include <algorithm>

namespace Orbane {

namespace {

// Numbers as Lua's tostring prints them.
QString NumberText(float64 n)
{
    return QString::asprintf("%.14g", n);
}

// A value inside an inline summary.
QString SummaryValue(const ScriptVal &v)
{
    if (v.IsString() || v.IsNumber() || v.IsBool())
        return ScriptValTreeWidget::PlainText(v);
    return v.IsTable() ? QStringLiteral("<subtable>") : QStringLiteral("<unknown>");
}

} // namespace

ScriptValTreeWidget::ScriptValTreeWidget(QWidget *parent) : QTreeWidget(parent) {}

ScriptValTreeWidget::~ScriptValTreeWidget() = default;

QString ScriptValTreeWidget::PlainText(const ScriptVal &value)
{
    if (value.IsString())
        return QString::fromUtf8(value.GetString());
    if (value.IsNumber())
        return NumberText(value.GetNumber());
    if (value.IsBool())
        return value.GetBool() ? QStringLiteral("true") : QStringLiteral("false");
    return QString();
}

QString ScriptValTreeWidget::KeyText(const ScriptVal &key)
{
    const QString plain = PlainText(key);
    return plain.isEmpty() && !key.IsString() ? QString::fromLatin1(key.TypeName()) : plain;
}

QString ScriptValTreeWidget::Summary(const ScriptVal &table)
{
    QStringList entries;
    for (const ScriptVal::Entry &entry : table.GetEntries()) {
        const QString name = entry.first.IsString() ? QString::fromUtf8(entry.first.GetString()) + " = " : QString();
        entries << name + SummaryValue(entry.second);
    }
    // An empty table keeps both blanks: "{  }".
    return "{ " + entries.join(", ") + " }";
}

// A sub-table grows child rows where it has a named key and sits among other
// keys of its parent, or where it holds a table itself: { a = 1, b = { c = 2 } }
// shows "c" under "b", while a lone { t = { a = 1 } } reads inline.
bool ScriptValTreeWidget::HasStructure(const ScriptVal &table, const ScriptVal &parent)
{
    const ScriptVal::Entries &entries = table.GetEntries();
    const auto named = [](const ScriptVal::Entry &e) { return e.first.IsString(); };
    const auto subtable = [](const ScriptVal::Entry &e) { return e.second.IsTable(); };
    return !entries.empty() &&
           ((parent.GetEntries().size() > 1 && std::any_of(entries.begin(), entries.end(), named)) ||
            std::any_of(entries.begin(), entries.end(), subtable));
}

void ScriptValTreeWidget::Fill(QTreeWidgetItem *parent, const ScriptVal &table, bool nested)
{
    for (const ScriptVal::Entry &entry : table.GetEntries()) {
        const ScriptVal &value = entry.second;
        const bool children = value.IsTable() && !nested && HasStructure(value, table);
        QString text;
        if (value.IsTable() && !children)
            text = Summary(value);
        else if (!value.IsTable())
            text = PlainText(value);
        auto *row = new QTreeWidgetItem(parent, QStringList{KeyText(entry.first), text});
        if (children) {
            Fill(row, value, true);
            row->setExpanded(true);
        }
    }
}

QString ScriptValTreeWidget::SelectedText() const
{
    QString text;
    for (const QItemSelectionRange &range : selectionModel()->selection()) {
        for (int row = range.top(); row <= range.bottom(); ++row) {
            QStringList cells;
            for (int col = range.left(); col <= range.right(); ++col)
                cells << model()->index(row, col, range.parent()).data(Qt::DisplayRole).toString();
            text += cells.join('\t') + '\n';
        }
    }
    return text;
}

void ScriptValTreeWidget::keyPressEvent(QKeyEvent *event)
{
    if (event->matches(QKeySequence::Copy)) {
        QApplication::clipboard()->setText(SelectedText());
        event->accept();
        return;
    }
    QTreeWidget::keyPressEvent(event);
}

} // namespace Orbane
