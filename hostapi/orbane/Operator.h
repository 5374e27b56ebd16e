#pragma once

#include "orbane/OrbID.h"
#include "orbane/OrbString.h"
#include "orbane/ScriptObject.h"
#include "orbane/TagList.h"

#include <string>
#include <vector>

namespace Orbane {

class Input;
class OrbaneDoc;
class Parameter;

// A tool in the flow: a named instance of a registered tool type with its
// Inputs in declaration order. The tool owns its Inputs; a document that
// holds the tool keeps one reference to it.
class Operator : public RefObject
{
public:
    // `name` is the instance name ("Blur1"), `typeName` the registered tool
    // type ("Blur").
    Operator(const char *name, const char *typeName, const TagList &attrs = TagList());

    const char *GetName() const noexcept { return mName.c_str(); }
    const char *GetTypeName() const noexcept { return mTypeName.c_str(); }
    const TagList &GetAttrs() const noexcept { return mAttrs; }
    OrbaneDoc *GetDoc() const noexcept { return mDoc; }
    const char *ScriptTypeName() const override { return "Tool"; }

    // A locked tool's controls show its values but do not edit them.
    bool IsLocked() const noexcept { return mLocked; }
    void SetLocked(bool locked) noexcept { mLocked = locked; }

    // The tool file the tool was built from (absolute; empty for a tool made
    // from a table): a saved comp names it, so only such tools can be saved.
    const std::string &GetSourceFile() const noexcept { return mSourceFile; }
    void SetSourceFile(const std::string &path) { mSourceFile = path; }

    // Declares the next Input. Returns it (owned by the tool), or null with a
    // script error where the id is empty or taken, or where `def` is not of
    // `dataType`. `def` is copied; it may be null.
    Input *AddInput(const OrbID &id, const char *name, const OrbID &dataType, const TagList &attrs,
                    const Parameter *def);
    Input *FindInput(const OrbID &id) const;
    const std::vector<Input *> &Inputs() const noexcept { return mInputs; }

protected:
    ~Operator() override;

private:
    friend class OrbaneDoc;
    void SetDoc(OrbaneDoc *doc) noexcept { mDoc = doc; }

    OrbString mName;
    OrbString mTypeName;
    TagList mAttrs;
    OrbaneDoc *mDoc = nullptr;
    bool mLocked = false;
    std::string mSourceFile;
    std::vector<Input *> mInputs; // one reference each
};

} // namespace Orbane
