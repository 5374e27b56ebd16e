#include "orbane/Operator.h"

#include "orbane/Input.h"
#include "orbane/ScriptError.h"

namespace Orbane {

Operator::Operator(const char *name, const char *typeName, const TagList &attrs)
    : mName(name), mTypeName(typeName), mAttrs(attrs)
{
}

Operator::~Operator()
{
    // Undo steps may keep an Input alive after its tool; it must not point back.
    for (Input *in : mInputs) {
        in->ForgetOperator();
        in->DecRef();
    }
}

Input *Operator::AddInput(const OrbID &id, const char *name, const OrbID &dataType, const TagList &attrs,
                          const Parameter *def)
{
    const std::string tool = std::string("tool \"") + GetName() + "\"";
    if (id.IsEmpty()) {
        SetScriptError("An Input of " + tool + " needs an id");
        return nullptr;
    }
    if (FindInput(id)) {
        SetScriptError("Input \"" + id.str() + "\" of " + tool + " is declared twice");
        return nullptr;
    }
    if (def && def->DataType() != dataType) {
        SetScriptError("Input \"" + id.str() + "\" of " + tool + " takes " + dataType.str() + ", not " +
                       def->DataType().str());
        return nullptr;
    }
    mInputs.push_back(new Input(this, id, name, dataType, attrs, def));
    return mInputs.back();
}

Input *Operator::FindInput(const OrbID &id) const
{
    for (Input *in : mInputs)
        if (in->GetID() == id)
            return in;
    return nullptr;
}

} // namespace Orbane
