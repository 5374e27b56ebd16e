#pragma once

#include <cstddef>
#include <functional>
#include <string>

namespace Orbane {

// An identifier: the text is interned once per process, so copies are a
// pointer and comparing two identifiers compares pointers. The empty text is
// the null pointer, so every empty identifier is equal too.
class OrbID
{
public:
    OrbID() noexcept = default;
    OrbID(const char *text);
    OrbID(const std::string &text);

    const char *c_str() const noexcept { return mText ? mText : ""; }
    std::string str() const { return c_str(); }
    bool IsEmpty() const noexcept { return !mText; }

    bool operator==(const OrbID &o) const noexcept { return mText == o.mText; }
    bool operator!=(const OrbID &o) const noexcept { return !(*this == o); }
    bool operator==(const char *text) const;
    bool operator!=(const char *text) const { return !(*this == text); }
    // Orders by text, so sorted listings are alphabetical.
    bool operator<(const OrbID &o) const;

    const void *Key() const noexcept { return mText; }

private:
    const char *mText = nullptr;
};

} // namespace Orbane

template <>
struct std::hash<Orbane::OrbID>
{
    std::size_t operator()(const Orbane::OrbID &id) const noexcept { return std::hash<const void *>()(id.Key()); }
};
