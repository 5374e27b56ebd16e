#include "orbane/OrbID.h"

#include <cstring>
#include <mutex>
#include <unordered_set>

namespace Orbane {

namespace {

// The table is never destroyed: identifiers live in statics of every library
// and may be compared during static destruction, after any table would be gone.
struct InternTable
{
    std::mutex lock;
    std::unordered_set<std::string> texts;
};

InternTable &Table()
{
    static InternTable *table = new InternTable;
    return *table;
}

const char *Intern(const char *text, std::size_t length)
{
    if (!text || length == 0)
        return nullptr;
    InternTable &table = Table();
    std::lock_guard<std::mutex> guard(table.lock);
    // Elements of an unordered_set never move, so the pointer stays valid.
    return table.texts.emplace(text, length).first->c_str();
}

} // namespace

OrbID::OrbID(const char *text) : mText(Intern(text, text ? std::strlen(text) : 0)) {}

OrbID::OrbID(const std::string &text) : mText(Intern(text.c_str(), text.size())) {}

bool OrbID::operator==(const char *text) const
{
    return std::strcmp(c_str(), text ? text : "") == 0;
}

bool OrbID::operator<(const OrbID &o) const
{
    return std::strcmp(c_str(), o.c_str()) < 0;
}

} // namespace Orbane
