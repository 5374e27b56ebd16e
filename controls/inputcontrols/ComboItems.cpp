#include "inputcontrols/ComboItems.h"

#include <QString>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// A value of another type than its tag promises reads as the default, as
// TagList's own getters do.
OrbString TextOf(const TagItem &item)
{
    return item.kind == TagKind::Text ? item.s : OrbString();
}

// One run of digits of `s` from `i`: its number without leading zeros.
QStringRef DigitRun(const QString &s, int &i)
{
    while (i < s.size() - 1 && s[i] == QLatin1Char('0') && s[i + 1].isDigit())
        ++i;
    const int start = i;
    while (i < s.size() && s[i].isDigit())
        ++i;
    return s.midRef(start, i - start);
}

// Negative, zero or positive as `a` sorts before, with or after `b`.
int NaturalCompare(const QString &a, const QString &b)
{
    int i = 0, j = 0;
    while (i < a.size() && j < b.size()) {
        if (a[i].isDigit() && b[j].isDigit()) {
            const QStringRef x = DigitRun(a, i), y = DigitRun(b, j);
            if (x.size() != y.size())
                return x.size() - y.size();
            if (const int c = x.compare(y))
                return c;
            continue;
        }
        const QChar x = a[i++].toCaseFolded(), y = b[j++].toCaseFolded();
        if (x != y)
            return x.unicode() - y.unicode();
    }
    return (a.size() - i) - (b.size() - j);
}

} // namespace

void ComboItems::Clear()
{
    *this = ComboItems();
}

void ComboItems::Append(const OrbString &text, bool separator)
{
    Texts.push_back(text);
    SecondTexts.emplace_back();
    IDs.emplace_back(separator ? OrbID() : OrbID(text.str()));
    Values.push_back(kSeparatorValue);
    Integers.push_back(0);
    Pointers.push_back(nullptr);
    mSeparator.push_back(separator);
    ++mCount;
}

void ComboItems::Read(const TagList &attrs)
{
    int32 ordinal = 0;
    bool open = false; // the last item may still take modifier tags
    for (const TagItem *item = attrs.First(); item; item = attrs.Next(item)) {
        const std::size_t last = Texts.size() - 1;
        switch (item->tag) {
        case AddString:
            Append(TextOf(*item), false);
            Values.back() = float64(ordinal++);
            open = true;
            break;
        case AddSeparator:
            Append(OrbString(), true);
            open = false;
            break;
        case ItemInteger:
            if (open && item->kind == TagKind::Long)
                Integers[last] = item->l;
            break;
        case ItemValue:
            if (open && item->kind == TagKind::Double)
                Values[last] = item->d;
            break;
        case ItemSecondText:
            if (open)
                SecondTexts[last] = TextOf(*item);
            break;
        case ItemPointer:
            if (open && item->kind == TagKind::Ptr)
                Pointers[last] = item->ptr;
            break;
        case ItemID:
            if (open && item->kind == TagKind::ID)
                IDs[last] = item->id;
            break;
        default:
            break;
        }
    }
}

int32 ComboItems::Nearest(float64 value) const
{
    // Separators take part with their placeholder value: a number within
    // reach of it selects the separator, whose value is then what closing
    // the control writes back.
    int32 found = -1;
    float64 best = kNearEnough;
    for (int32 i = 0; i < mCount; ++i) {
        const float64 distance = std::fabs(value - Values[std::size_t(i)]);
        if (distance < best) {
            best = distance;
            found = i;
        }
    }
    return found;
}

int32 ComboItems::FindID(const OrbID &id) const
{
    // The first equal identifier, a separator's too: NOID finds the first
    // separator.
    for (int32 i = 0; i < mCount; ++i)
        if (IDs[std::size_t(i)] == id)
            return i;
    return -1;
}

std::vector<int32> ComboItems::RowOrder(bool alphaSort) const
{
    std::vector<int32> order(std::size_t(mCount), 0);
    for (int32 i = 0; i < mCount; ++i)
        order[std::size_t(i)] = i;
    if (!alphaSort)
        return order;
    const auto byText = [this](int32 a, int32 b) { return TextLess(Texts[std::size_t(a)], Texts[std::size_t(b)]); };
    auto runStart = order.begin();
    for (auto it = order.begin(); it != order.end(); ++it) {
        if (mSeparator[std::size_t(*it)]) {
            std::stable_sort(runStart, it, byText);
            runStart = it + 1;
        }
    }
    std::stable_sort(runStart, order.end(), byText);
    return order;
}

bool ComboItems::TextLess(const OrbString &a, const OrbString &b)
{
    const int c = NaturalCompare(QString::fromStdString(a.str()), QString::fromStdString(b.str()));
    return c != 0 ? c < 0 : a < b;
}

} // namespace Orbane
