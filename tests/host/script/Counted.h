#pragma once

#include "orbane/ScriptObject.h"

namespace Orbane::TestKit {

// A counted object that reports its deletion, so tests can see references
// being taken and given back.
class Counted : public RefObject
{
public:
    explicit Counted(int *deaths, const char *typeName = "Counted") : mDeaths(deaths), mTypeName(typeName) {}
    ~Counted() override { ++*mDeaths; }

    const char *ScriptTypeName() const override { return mTypeName; }

private:
    int *mDeaths;
    const char *mTypeName;
};

} // namespace Orbane::TestKit
