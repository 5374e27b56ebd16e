#pragma once

#include <string>

namespace Orbane {

// The host's owned text. A thin value type over std::string so that the
// contract does not depend on Qt's QString.
class OrbString
{
public:
    OrbString() = default;
    OrbString(const char *text) : mText(text ? text : "") {}
    OrbString(std::string text) : mText(std::move(text)) {}

    const char *c_str() const noexcept { return mText.c_str(); }
    const std::string &str() const noexcept { return mText; }
    bool IsEmpty() const noexcept { return mText.empty(); }
    std::size_t Length() const noexcept { return mText.size(); }

    bool operator==(const OrbString &o) const noexcept { return mText == o.mText; }
    bool operator!=(const OrbString &o) const noexcept { return mText != o.mText; }
    bool operator<(const OrbString &o) const noexcept { return mText < o.mText; }

private:
    std::string mText;
};

using OrbStringT = OrbString;

} // namespace Orbane
