#include "polyline/PolyNumbersDialog.h"

#include <QDialogButtonBox>
#include <QFormLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRegularExpression>
#include <QVBoxLayout>

#include <cmath>

namespace Orbane {

PolyNumbersDialog::PolyNumbersDialog(QWidget *parent, const QString &title, const QString &objectName,
                                     std::vector<Field> fields, Done done)
    : QDialog(parent), mFields(std::move(fields)), mMessage(new QLabel(this)), mDone(std::move(done))
{
    setObjectName(objectName);
    setWindowTitle(title);
    setModal(false);
    auto *form = new QFormLayout;
    for (const Field &f : mFields) {
        auto *edit = new QLineEdit(QString::number(f.value, 'g', 8), this);
        edit->setObjectName(f.name);
        form->addRow(tr(f.label), edit);
        mEdits.push_back(edit);
    }
    mMessage->setObjectName("numbersMessage");
    mMessage->setWordWrap(true);
    auto *buttons = new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel, this);
    buttons->button(QDialogButtonBox::Ok)->setObjectName("numbersOk");
    buttons->button(QDialogButtonBox::Cancel)->setObjectName("numbersCancel");
    connect(buttons, &QDialogButtonBox::accepted, this, [this] { Accept(); });
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    auto *layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addWidget(mMessage);
    layout->addWidget(buttons);
}

std::string PolyNumbersDialog::Check(const Field &field, float64 value)
{
    const std::string name = field.label;
    if (!std::isfinite(value) || value < field.low || value > field.high)
        return name + ": give a number from " + QString::number(field.low).toStdString() + " to " +
               QString::number(field.high).toStdString();
    if (field.whole && value != std::floor(value))
        return name + ": give a whole number";
    return "";
}

bool PolyNumbersDialog::Parse(const std::vector<Field> &fields, const std::string &text, std::vector<float64> &values,
                              std::string &why)
{
    values.clear();
    for (const Field &f : fields)
        values.push_back(f.value);
    const QStringList words = QString::fromStdString(text).split(QRegularExpression("[\\s,]+"), Qt::SkipEmptyParts);
    if (words.size() > int(fields.size())) {
        why = "give at most " + std::to_string(fields.size()) + " numbers";
        return false;
    }
    for (int i = 0; i < words.size(); ++i) {
        bool ok = false;
        const float64 v = words[i].toDouble(&ok);
        why = ok ? Check(fields[std::size_t(i)], v)
                 : std::string(fields[std::size_t(i)].label) + ": \"" + words[i].toStdString() + "\" is not a number";
        if (!why.empty())
            return false;
        values[std::size_t(i)] = v;
    }
    return true;
}

void PolyNumbersDialog::Accept()
{
    QStringList texts;
    for (const QLineEdit *e : mEdits)
        texts << e->text().trimmed();
    std::vector<float64> values;
    std::string why;
    // An empty field is a mistake here, not "keep": every field counts.
    for (std::size_t i = 0; i < mEdits.size() && why.empty(); ++i)
        if (texts[int(i)].isEmpty() || texts[int(i)].contains(QRegularExpression("[\\s,]")))
            why = std::string(mFields[i].label) + ": give a number";
    if (why.empty() && Parse(mFields, texts.join(' ').toStdString(), values, why))
        why = mDone(values);
    mMessage->setText(QString::fromStdString(why));
    if (why.empty())
        accept();
}

} // namespace Orbane
