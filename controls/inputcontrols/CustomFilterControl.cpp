#include "inputcontrols/CustomFilterControl.h"

#include "widgets/KernelPreview.h"

#include "orbane/ElideLabel.h"
#include "orbane/LayoutContainer.h"
#include "orbane/LayoutObj.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>

#include <memory>

namespace Orbane {

namespace {

constexpr const char *kLayoutItem = "Controls.CustomFilter.Layout";
constexpr int32 kCellSpacing = 2;

QString Number(float64 v)
{
    return QLocale::c().toString(v, 'g', 6);
}

std::string CellName(int32 i)
{
    return "cell" + std::to_string(i + 1);
}

} // namespace

CustomFilterControl::CustomFilterControl(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : TableInputControl(reg, args, tags), mKernel(Kernel::Identity(3)), mSize(new QComboBox(this)),
      mBlur(new QPushButton("Blur", this)), mSharpen(new QPushButton("Sharpen", this)),
      mEdge(new QPushButton("Edge", this)), mNormalise(new QPushButton("Normalise", this)),
      mPreview(new KernelPreview(this)), mMessage(new QLabel(this))
{
    for (int32 i = 0; i < kMaxCells; ++i) {
        QLineEdit *cell = new QLineEdit(this);
        cell->setObjectName(QString::fromStdString(CellName(i)));
        cell->setAlignment(Qt::AlignRight);
        cell->hide();
        connect(cell, SIGNAL(editingFinished()), this, SLOT(OnCellTyped()));
        mCells[std::size_t(i)] = cell;
    }
    for (int32 size : Kernel::kSizes)
        mSize->addItem(QString("%1x%1").arg(size));
    connect(mSize, SIGNAL(activated(int)), this, SLOT(OnSizeChosen(int)));
    const std::pair<const char *, QWidget *> children[] = {
        {"size", mSize},           {"blur", mBlur},       {"sharpen", mSharpen}, {"edge", mEdge},
        {"normalise", mNormalise}, {"preview", mPreview}, {"message", mMessage}};
    for (const auto &[name, child] : children) {
        child->setObjectName(name);
        RegisterChild(name, child);
    }
    for (QPushButton *preset : {mBlur, mSharpen, mEdge})
        connect(preset, SIGNAL(clicked()), this, SLOT(OnPreset()));
    connect(mNormalise, SIGNAL(clicked()), this, SLOT(OnNormalise()));
    mMessage->setWordWrap(true);
    Label()->setFocusProxy(mCells[0]);
    ClassLayout(kLayoutItem);
}

CustomFilterControl::~CustomFilterControl() = default;

Kernel CustomFilterControl::KernelOf(const ScriptVal &table)
{
    if (!table.IsTable() || table.GetEntries().empty())
        return Kernel::Identity(3);
    std::vector<std::vector<float64>> rows;
    for (const auto &[key, row] : table.GetEntries()) {
        if (!key.IsNumber())
            continue;
        rows.emplace_back();
        if (row.IsTable())
            for (const auto &[col, cell] : row.GetEntries())
                if (col.IsNumber())
                    rows.back().push_back(cell.GetNumber(0.0));
    }
    return Kernel::FromRows(rows);
}

ScriptVal CustomFilterControl::TableOf(const Kernel &kernel)
{
    ScriptVal table = ScriptVal::NewTable();
    for (int32 r = 0; r < kernel.Size(); ++r) {
        ScriptVal row = ScriptVal::NewTable();
        for (int32 c = 0; c < kernel.Size(); ++c)
            row.Append(kernel.At(r, c));
        table.Append(row);
    }
    return table;
}

bool CustomFilterControl::Open(QWidget *host, const QRect &rect, const TagList *tags)
{
    if (!TableInputControl::Open(host, rect, tags))
        return false;
    ShowValue();
    return true;
}

// Builds the layout again with the cells of the kernel's size in the grid.
void CustomFilterControl::Arrange()
{
    const int32 n = mKernel.Size();
    mArranged = n;
    for (int32 i = 0; i < kMaxCells; ++i)
        mCells[std::size_t(i)]->setVisible(i < n * n);
    PlaceChildren(ClassLayout(kLayoutItem), false);
    Layout::LayoutObj *where = FindLayoutObj("cells");
    Layout::Container *grid = where ? where->AsContainer() : nullptr;
    if (!grid)
        return;
    grid->SetSpacing(kCellSpacing, kCellSpacing);
    for (int32 i = 0; i < n * n; ++i) {
        QLineEdit *cell = mCells[std::size_t(i)];
        grid->AddAt(std::make_unique<Layout::LayoutObj>(OrbID(CellName(i)), cell), i / n, i % n);
    }
}

void CustomFilterControl::ShowValue()
{
    mKernel = KernelOf(Value());
    const int32 n = mKernel.Size();
    if (n != mArranged)
        Arrange();
    for (int32 i = 0; i < n * n; ++i)
        if (!mCells[std::size_t(i)]->isModified())
            mCells[std::size_t(i)]->setText(Number(mKernel.Cells()[std::size_t(i)]));
    mSize->setCurrentIndex(n == 3 ? 0 : n == 5 ? 1 : 2);
    mPreview->SetKernel(mKernel);
}

void CustomFilterControl::Say(const QString &message)
{
    mMessage->setText(message);
}

void CustomFilterControl::Write(const Kernel &kernel)
{
    Say(QString());
    if (kernel == KernelOf(Value()) && Value().IsTable())
        return;
    WriteValue(TableOf(kernel));
    EndGesture();
    ShowValue();
}

// A cell that does not read as a number goes back to what it was.
void CustomFilterControl::OnCellTyped()
{
    auto *cell = qobject_cast<QLineEdit *>(sender());
    if (!cell || !cell->isModified())
        return;
    cell->setModified(false);
    const int32 index = int32(std::find(mCells.begin(), mCells.end(), cell) - mCells.begin());
    bool ok = false;
    const float64 typed = QLocale::c().toDouble(cell->text().trimmed(), &ok);
    if (!ok || !std::isfinite(typed) || index >= mKernel.Size() * mKernel.Size()) {
        Say(QString("\"%1\" is not a number").arg(cell->text()));
        cell->setText(Number(mKernel.Cells()[std::size_t(std::min(index, mKernel.Size() * mKernel.Size() - 1))]));
        return;
    }
    Kernel k = mKernel;
    k.Set(index / k.Size(), index % k.Size(), typed);
    Write(k);
}

void CustomFilterControl::OnSizeChosen(int index)
{
    Write(mKernel.Resized(Kernel::kSizes[std::clamp(index, 0, 2)]));
}

void CustomFilterControl::OnPreset()
{
    const int32 n = mKernel.Size();
    if (sender() == mBlur)
        Write(Kernel::Blur(n));
    else if (sender() == mSharpen)
        Write(Kernel::Sharpen(n));
    else
        Write(Kernel::Edge(n));
}

void CustomFilterControl::OnNormalise()
{
    Kernel k = mKernel;
    switch (k.Normalise()) {
    case Kernel::Normalised::AllZero:
        Say("Every cell is 0: there is nothing to normalise.");
        return;
    case Kernel::Normalised::ZeroSum:
        Say("The cells sum to 0 (an edge kernel): normalising would divide by 0.");
        return;
    case Kernel::Normalised::Done:
        Write(k);
        return;
    }
}

} // namespace Orbane
