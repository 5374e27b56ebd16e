#include "orbane/LayoutContainer.h"

#include "LayoutBuilder.h"

#include <QBoxLayout>
#include <QGridLayout>

namespace Orbane {
namespace Layout {

namespace {

constexpr int kDefaultSpacing = 4;

std::unique_ptr<QLayout> MakeLayout(Container::Kind kind)
{
    std::unique_ptr<QLayout> layout;
    if (kind == Container::Grid) {
        auto grid = std::make_unique<QGridLayout>();
        grid->setHorizontalSpacing(kDefaultSpacing);
        grid->setVerticalSpacing(kDefaultSpacing);
        layout = std::move(grid);
    } else {
        const auto dir = kind == Container::HBox ? QBoxLayout::LeftToRight : QBoxLayout::TopToBottom;
        layout = std::make_unique<QBoxLayout>(dir);
        layout->setSpacing(kDefaultSpacing);
    }
    layout->setContentsMargins(0, 0, 0, 0);
    return layout;
}

} // namespace

Container::Container(const OrbID &name, Kind kind) : LayoutObj(name, nullptr), mKind(kind), mLayout(MakeLayout(kind)) {}

Container::~Container() = default;

std::unique_ptr<Container> Container::Create(const ScriptVal &description, const WidgetMap &widgets)
{
    return LayoutBuilder(widgets).Build(description);
}

LayoutObj *Container::Find(const OrbID &name)
{
    if (GetName() == name && !name.IsEmpty())
        return this;
    for (LayoutObj *obj : mObjs) {
        if (Container *inner = obj->AsContainer()) {
            if (LayoutObj *found = inner->Find(name))
                return found;
        } else if (obj->GetName() == name) {
            return obj;
        }
    }
    return nullptr;
}

const LayoutObj *Container::Find(const OrbID &name) const
{
    return const_cast<Container *>(this)->Find(name);
}

LayoutObj *Container::Add(std::unique_ptr<LayoutObj> obj, int32 stretch)
{
    if (!obj)
        return nullptr;
    LayoutObj *raw = obj.get();
    if (auto *box = qobject_cast<QBoxLayout *>(mLayout.get())) {
        box->addItem(obj.release());
        box->setStretch(box->count() - 1, std::max(0, stretch));
    } else {
        auto *grid = static_cast<QGridLayout *>(mLayout.get());
        // Appended to a grid: a new row of its own under the others.
        const int row = grid->count() == 0 ? 0 : grid->rowCount();
        grid->addItem(obj.release(), row, 0);
    }
    mObjs.push_back(raw);
    return raw;
}

LayoutObj *Container::AddWidget(const OrbID &name, QWidget *widget, int32 stretch)
{
    return Add(std::make_unique<LayoutObj>(name, widget), stretch);
}

LayoutObj *Container::AddAt(std::unique_ptr<LayoutObj> obj, int32 row, int32 col, int32 rowSpan, int32 colSpan)
{
    auto *grid = qobject_cast<QGridLayout *>(mLayout.get());
    if (!grid || !obj || row < 0 || col < 0)
        return grid ? nullptr : Add(std::move(obj));
    LayoutObj *raw = obj.get();
    grid->addItem(obj.release(), row, col, std::max(1, rowSpan), std::max(1, colSpan));
    mObjs.push_back(raw);
    return raw;
}

LayoutObj *Container::At(int32 index) const
{
    return index >= 0 && index < Count() ? mObjs[std::size_t(index)] : nullptr;
}

void Container::SetSpacing(int32 horizontal, int32 vertical)
{
    if (auto *grid = qobject_cast<QGridLayout *>(mLayout.get())) {
        grid->setHorizontalSpacing(std::max(0, horizontal));
        grid->setVerticalSpacing(std::max(0, vertical));
    } else {
        mLayout->setSpacing(std::max(0, mKind == HBox ? horizontal : vertical));
    }
}

void Container::SetMargins(const QMargins &margins)
{
    mLayout->setContentsMargins(margins);
}

void Container::SetColumnStretch(int32 col, int32 stretch)
{
    if (auto *grid = qobject_cast<QGridLayout *>(mLayout.get()); grid && col >= 0)
        grid->setColumnStretch(col, std::max(0, stretch));
}

void Container::SetRowStretch(int32 row, int32 stretch)
{
    if (auto *grid = qobject_cast<QGridLayout *>(mLayout.get()); grid && row >= 0)
        grid->setRowStretch(row, std::max(0, stretch));
}

int32 Container::HeightForWidth(int32 width) const
{
    const int hfw = hasHeightForWidth() ? heightForWidth(width) : -1;
    const int height = hfw >= 0 ? hfw : sizeHint().height();
    return std::max(height, minimumSize().height());
}

int32 Container::Arrange(int32 width)
{
    // Children's size hints may have changed since the last call (texts,
    // fonts, shown or hidden widgets), and no widget event reaches a layout
    // that is not installed on a widget: start from fresh measurements.
    invalidate();
    const int32 height = HeightForWidth(width);
    Place(QRect(0, 0, width, height));
    return height;
}

void Container::Place(const QRect &rect)
{
    setGeometry(rect);
}

void Container::invalidate()
{
    for (LayoutObj *obj : mObjs)
        obj->invalidate();
    mLayout->invalidate();
}

QLayoutItem *Container::Content() const
{
    return mLayout.get();
}

bool Container::ContentIsEmpty() const
{
    return mLayout->isEmpty();
}

} // namespace Layout
} // namespace Orbane
