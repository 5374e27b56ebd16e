#pragma once

#include "inputcontrols/TableInputControl.h"
#include "widgets/Kernel.h"

#include <array>

class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;

namespace Orbane {

class KernelPreview;

// An editable N x N convolution kernel (3, 5 or 7) in one script-table
// Input, as its rows: { {1, 2, 1}, {2, 4, 2}, {1, 2, 1} }. The cells
// ("cell1" .. "cellNN", row by row) are typed; "size" resizes about the
// centre; "blur", "sharpen" and "edge" put in those kernels; "normalise"
// scales the cells to sum to 1, and refuses, saying why in "message", where
// they sum to 0. "preview" pictures the kernel. Each is one undo step.
class CustomFilterControl : public TableInputControl
{
    Q_OBJECT
public:
    static constexpr int32 kMaxCells = 49;

    CustomFilterControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~CustomFilterControl() override;

    std::size_t SizeOf() const override { return sizeof(CustomFilterControl); }

    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;

    static Kernel KernelOf(const ScriptVal &table);
    static ScriptVal TableOf(const Kernel &kernel);
    const Kernel &Shown() const noexcept { return mKernel; }

protected:
    void ShowValue() override;

private slots:
    void OnCellTyped();
    void OnSizeChosen(int index);
    void OnPreset();
    void OnNormalise();

private:
    void Arrange();
    void Write(const Kernel &kernel);
    void Say(const QString &message);

    Kernel mKernel;
    int32 mArranged = 0; // the size the cells are laid out for
    std::array<QLineEdit *, kMaxCells> mCells;
    QComboBox *mSize;
    QPushButton *mBlur;
    QPushButton *mSharpen;
    QPushButton *mEdge;
    QPushButton *mNormalise;
    KernelPreview *mPreview;
    QLabel *mMessage;
};

} // namespace Orbane
