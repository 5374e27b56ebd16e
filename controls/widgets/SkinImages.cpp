#include "widgets/SkinImages.h"

#include "orbane/DIB.h"

#include <functional>
#include <map>
#include <string>

namespace Orbane {

namespace {

class Cache
{
public:
    ~Cache()
    {
        for (auto &entry : mImages)
            if (entry.second)
                entry.second->Recycle();
    }

    DIB *Get(const char *name)
    {
        auto found = mImages.find(name);
        if (found == mImages.end())
            found = mImages.emplace(name, DIB::FromResource(name, SkinImages::Ratio)).first;
        return found->second;
    }

private:
    // Found by the name as given: no string is made for a lookup on each paint.
    std::map<std::string, DIB *, std::less<>> mImages;
};

} // namespace

DIB *SkinImages::Get(const char *name)
{
    static Cache cache;
    return name ? cache.Get(name) : nullptr;
}

} // namespace Orbane
