#include "LayoutBuilder.h"

#include "orbane/LookPackItem.h"

#include <QStringList>
#include <QtGlobal>

#include <algorithm>
#include <cmath>

namespace Orbane {
namespace Layout {

namespace {

const ScriptVal *Key(const ScriptVal &node, const char *key)
{
    return node.IsTable() ? node.FindKeyConst(ScriptVal(key)) : nullptr;
}

// Layout numbers come from look packs, which may come from outside: a grid
// cell or a size beyond these is refused (with a warning, the default used),
// before Qt is asked for two billion rows.
constexpr int32 kMaxCell = 1000;
constexpr int32 kMaxPixels = 1 << 20;

// A number of the layout rounded to an integer within lo..hi, else def.
int32 Bounded(const ScriptVal *v, const char *key, int32 def, int32 lo, int32 hi)
{
    if (!v || !v->IsNumber())
        return def;
    const float64 n = std::round(v->GetNumber());
    if (n >= lo && n <= hi)
        return int32(n);
    qWarning("Layout: %s = %g is outside %d..%d", key, v->GetNumber(), lo, hi);
    return def;
}

int32 IntKey(const ScriptVal &node, const char *key, int32 def, int32 lo = -1, int32 hi = kMaxPixels)
{
    return Bounded(Key(node, key), key, def, lo, hi);
}

std::string StrKey(const ScriptVal &node, const char *key)
{
    const ScriptVal *v = Key(node, key);
    return v && v->IsString() ? v->GetString() : std::string();
}

Qt::Alignment ParseAlign(const std::string &text)
{
    Qt::Alignment align;
    for (const QString &part : QString::fromStdString(text).split(QLatin1Char('|'), Qt::SkipEmptyParts)) {
        const QString word = part.trimmed().toLower();
        if (word == QLatin1String("left"))
            align |= Qt::AlignLeft;
        else if (word == QLatin1String("right"))
            align |= Qt::AlignRight;
        else if (word == QLatin1String("hcenter"))
            align |= Qt::AlignHCenter;
        else if (word == QLatin1String("top"))
            align |= Qt::AlignTop;
        else if (word == QLatin1String("bottom"))
            align |= Qt::AlignBottom;
        else if (word == QLatin1String("vcenter"))
            align |= Qt::AlignVCenter;
        else if (word == QLatin1String("center"))
            align |= Qt::AlignCenter;
        else
            qWarning("Layout: unknown alignment \"%s\"", qPrintable(word));
    }
    return align;
}

// Entry i of a Lua list as an integer; 0 where it is missing, no number or
// out of range.
int32 IntAt(const ScriptVal &list, int32 i)
{
    return Bounded(list.FindKeyConst(ScriptVal(i)), "list entry", 0, -kMaxPixels, kMaxPixels);
}

QMargins ParseMargins(const ScriptVal &node)
{
    const ScriptVal *m = Key(node, "margins");
    if (!m)
        return QMargins();
    if (m->IsNumber()) {
        const int all = Bounded(m, "margins", 0, -kMaxPixels, kMaxPixels);
        return QMargins(all, all, all, all);
    }
    return QMargins(IntAt(*m, 1), IntAt(*m, 2), IntAt(*m, 3), IntAt(*m, 4));
}

bool HasChildren(const ScriptVal &node)
{
    return node.IsTable() && node.Length() > 0;
}

ScriptVal Table(std::initializer_list<std::pair<const char *, ScriptVal>> keys,
                std::initializer_list<ScriptVal> children = {})
{
    ScriptVal t = ScriptVal::NewTable();
    for (const auto &kv : keys)
        t.SetKey(ScriptVal(kv.first), kv.second);
    for (const ScriptVal &child : children)
        t.Append(child);
    return t;
}

} // namespace

ScriptVal LayoutBuilder::BuiltInDefault()
{
    const ScriptVal row = Table({{"kind", "hbox"}}, {Table({{"kind", "rest"}})});
    const ScriptVal expression = Table({{"kind", "vbox"}, {"name", "expression"}});
    return Table({{"kind", "vbox"}}, {row, expression});
}

const ScriptVal &LayoutBuilder::DefaultDescription()
{
    static const ScriptVal description = [] {
        const ScriptVal &item = LookPackItem("Controls.Default.Layout").GetItemData();
        const ScriptVal *desc = item.FindKeyConst(ScriptVal(1));
        return desc && desc->IsTable() ? *desc : BuiltInDefault();
    }();
    return description;
}

std::unique_ptr<Container> LayoutBuilder::Build(const ScriptVal &description)
{
    const ScriptVal &desc = description.IsTable() || description.IsString() ? description : DefaultDescription();
    mNamed.clear();
    mPlaced.clear();
    CollectNames(desc);
    std::unique_ptr<LayoutObj> root = MakeNode(desc);
    if (root && root->AsContainer())
        return std::unique_ptr<Container>(static_cast<Container *>(root.release()));
    auto box = std::make_unique<Container>(OrbID(), Container::VBox);
    if (root)
        box->Add(std::move(root));
    return box;
}

void LayoutBuilder::CollectNames(const ScriptVal &node)
{
    if (node.IsString()) {
        mNamed.insert(OrbID(node.GetString()));
        return;
    }
    const std::string name = StrKey(node, "name");
    if (!name.empty())
        mNamed.insert(OrbID(name));
    for (int32 i = 1; HasChildren(node) && i <= node.Length(); ++i)
        if (const ScriptVal *child = node.FindKeyConst(ScriptVal(i)))
            CollectNames(*child);
}

std::unique_ptr<LayoutObj> LayoutBuilder::MakeNode(const ScriptVal &node)
{
    if (node.IsString())
        return MakeItem(OrbID(node.GetString()));
    if (!node.IsTable())
        return nullptr;

    std::string kind = StrKey(node, "kind");
    if (kind.empty())
        kind = HasChildren(node) ? "vbox" : "item";

    std::unique_ptr<LayoutObj> obj;
    if (kind == "hbox")
        obj = MakeContainer(node, Container::HBox);
    else if (kind == "vbox")
        obj = MakeContainer(node, Container::VBox);
    else if (kind == "grid")
        obj = MakeContainer(node, Container::Grid);
    else if (kind == "item")
        obj = MakeItem(OrbID(StrKey(node, "name")));
    else if (kind == "space" || kind == "stretch") {
        obj = std::make_unique<LayoutObj>(OrbID(StrKey(node, "name")), nullptr);
        obj->SetExpanding(kind == "stretch");
    } else {
        qWarning("Layout: unknown kind \"%s\"", kind.c_str());
    }
    if (obj)
        ApplySizes(*obj, node);
    return obj;
}

std::unique_ptr<LayoutObj> LayoutBuilder::MakeItem(const OrbID &name)
{
    // A name the control did not register, or one already placed, gets no
    // place: the control skips what it would have done with it.
    QWidget *widget = mWidgets.Find(name);
    if (!widget || !mPlaced.insert(name).second)
        return nullptr;
    return std::make_unique<LayoutObj>(name, widget);
}

std::unique_ptr<Container> LayoutBuilder::MakeContainer(const ScriptVal &node, Container::Kind kind)
{
    auto box = std::make_unique<Container>(OrbID(StrKey(node, "name")), kind);
    ApplyBox(*box, node);
    AddChildren(*box, node);
    return box;
}

void LayoutBuilder::AddChildren(Container &box, const ScriptVal &node)
{
    for (int32 i = 1; HasChildren(node) && i <= node.Length(); ++i) {
        const ScriptVal *child = node.FindKeyConst(ScriptVal(i));
        if (!child)
            continue;
        if (StrKey(*child, "kind") == "rest")
            AddRest(box);
        else
            AddChild(box, MakeNode(*child), *child);
    }
}

void LayoutBuilder::AddRest(Container &box)
{
    for (const WidgetMap::Entry &entry : mWidgets.Entries()) {
        if (!entry.second || mNamed.count(entry.first))
            continue;
        if (std::unique_ptr<LayoutObj> obj = MakeItem(entry.first))
            box.Add(std::move(obj), box.GetKind() == Container::HBox ? 1 : 0);
    }
}

void LayoutBuilder::AddChild(Container &box, std::unique_ptr<LayoutObj> obj, const ScriptVal &node)
{
    if (!obj)
        return;
    if (box.GetKind() != Container::Grid) {
        box.Add(std::move(obj), IntKey(node, "stretch", 0, 0, kMaxCell));
        return;
    }
    // Lua counts from 1, Qt's grid from 0.
    const int32 row = IntKey(node, "row", 1, 1, kMaxCell) - 1;
    const int32 col = IntKey(node, "col", 1, 1, kMaxCell) - 1;
    box.AddAt(std::move(obj), row, col, IntKey(node, "rowspan", 1, 1, kMaxCell),
              IntKey(node, "colspan", 1, 1, kMaxCell));
}

void LayoutBuilder::ApplySizes(LayoutObj &obj, const ScriptVal &node)
{
    if (!node.IsTable())
        return;
    obj.SetFixedSize(IntKey(node, "width", -1), IntKey(node, "height", -1));
    obj.SetMinSize(IntKey(node, "minwidth", -1), IntKey(node, "minheight", -1));
    obj.SetMaxSize(IntKey(node, "maxwidth", -1), IntKey(node, "maxheight", -1));
    const std::string align = StrKey(node, "align");
    if (!align.empty())
        obj.SetAlign(ParseAlign(align));
}

void LayoutBuilder::ApplyBox(Container &box, const ScriptVal &node)
{
    const int32 spacing = IntKey(node, "spacing", 4);
    box.SetSpacing(IntKey(node, "hspacing", spacing), IntKey(node, "vspacing", spacing));
    box.SetMargins(ParseMargins(node));
    if (const ScriptVal *cols = Key(node, "colstretch"))
        for (int32 i = 1; i <= std::min(cols->Length(), kMaxCell); ++i)
            box.SetColumnStretch(i - 1, IntAt(*cols, i));
    if (const ScriptVal *rows = Key(node, "rowstretch"))
        for (int32 i = 1; i <= std::min(rows->Length(), kMaxCell); ++i)
            box.SetRowStretch(i - 1, IntAt(*rows, i));
}

} // namespace Layout
} // namespace Orbane
