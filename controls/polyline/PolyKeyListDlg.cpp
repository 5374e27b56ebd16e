#include "polyline/PolyKeyListDlg.h"

#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineKeyEdit.h"

#include "orbane/Input.h"

#include <QDialogButtonBox>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QVBoxLayout>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// A key counts as the one at the current time this near to it.
constexpr float64 kAtTime = 1e-9;

} // namespace

PolyKeyListDlg::PolyKeyListDlg(PolyLineControl &control, QWidget *parent)
    : QDialog(parent), mControl(control), mList(new QListWidget(this)), mInfo(new QLabel(this))
{
    setObjectName("polyKeyList");
    setWindowTitle(tr("Polygon Keyframe List"));
    setModal(false);
    mList->setObjectName("keyList");
    mList->setSelectionMode(QAbstractItemView::ExtendedSelection);
    mInfo->setObjectName("keyInfo");
    auto *buttons = new QDialogButtonBox(this);
    QPushButton *jump = buttons->addButton(tr("Go To"), QDialogButtonBox::ActionRole);
    QPushButton *remove = buttons->addButton(tr("Delete"), QDialogButtonBox::ActionRole);
    QPushButton *close = buttons->addButton(QDialogButtonBox::Close);
    jump->setObjectName("keyJump");
    remove->setObjectName("keyDelete");
    close->setObjectName("keyClose");
    jump->setAutoDefault(false);
    remove->setAutoDefault(false);
    connect(jump, &QPushButton::clicked, this, [this] { JumpToChosen(); });
    connect(remove, &QPushButton::clicked, this, [this] { DeleteChosen(); });
    connect(close, &QPushButton::clicked, this, &QDialog::reject);
    connect(mList, &QListWidget::itemDoubleClicked, this, [this] { JumpToChosen(); });
    auto *layout = new QVBoxLayout(this);
    layout->addWidget(mList);
    layout->addWidget(mInfo);
    layout->addWidget(buttons);
    Refresh();
}

void PolyKeyListDlg::Refresh()
{
    const Input *main = mControl.GetMainInput();
    const std::vector<float64> keys = main && main->IsAnimated() ? main->KeyTimes() : std::vector<float64>();
    const float64 now = mControl.GetCurrentTime();
    if (keys == mShown && now == mShownTime && mList->count() == int(keys.size()))
        return;
    const std::vector<float64> chosen = Chosen();
    mList->clear();
    for (const float64 t : keys) {
        const bool current = std::fabs(t - now) < kAtTime;
        auto *item = new QListWidgetItem(QString::number(t, 'g', 10) + (current ? tr("  (now)") : QString()), mList);
        item->setData(Qt::UserRole, t);
        item->setSelected(std::find(chosen.begin(), chosen.end(), t) != chosen.end());
    }
    mShown = keys;
    mShownTime = now;
    mInfo->setText(keys.empty() ? tr("The shape is not animated") : tr("%n keyframe(s)", nullptr, int(keys.size())));
}

std::vector<float64> PolyKeyListDlg::Chosen() const
{
    std::vector<float64> times;
    for (int i = 0; i < mList->count(); ++i)
        if (mList->item(i)->isSelected())
            times.push_back(mList->item(i)->data(Qt::UserRole).toDouble());
    return times;
}

void PolyKeyListDlg::Say(const QString &why)
{
    mInfo->setText(why);
}

bool PolyKeyListDlg::JumpToChosen()
{
    const std::vector<float64> times = Chosen();
    if (times.empty()) {
        Say(tr("Choose a keyframe to go to"));
        return false;
    }
    const bool done = PolyLineKeyEdit(mControl).JumpTo(times.front());
    Refresh();
    return done;
}

bool PolyKeyListDlg::DeleteChosen()
{
    const std::vector<float64> times = Chosen();
    if (times.empty()) {
        Say(tr("Choose the keyframes to delete"));
        return false;
    }
    const bool done = PolyLineKeyEdit(mControl).DeleteKeys(times);
    Refresh();
    if (!done)
        Say(QString::fromUtf8(mControl.LastMessage().c_str()));
    return done;
}

} // namespace Orbane
