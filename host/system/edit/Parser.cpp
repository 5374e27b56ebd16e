#include "orbane/Parser.h"

#include <muParser.h>

#include <cmath>
#include <limits>
#include <map>
#include <string>

namespace Orbane {

struct Parser::Impl
{
    mu::Parser parser;
    std::string text;
    std::string error;
    bool valid = false;
    // Parser-owned variables; map nodes keep their addresses.
    std::map<std::string, float64> owned;

    // muParser builds its byte code on the first evaluation, so a trial run
    // here both checks the text and leaves it compiled for Evaluate.
    bool Compile()
    {
        valid = false;
        if (text.empty()) {
            error = "empty expression";
            return false;
        }
        try {
            parser.SetExpr(text);
            parser.Eval();
            valid = true;
            error.clear();
        } catch (const mu::Parser::exception_type &e) {
            error = e.GetMsg();
            text.clear();
        }
        return valid;
    }
};

Parser::Parser() : mImpl(std::make_unique<Impl>())
{
    mImpl->parser.DefineConst("pi", M_PI);
    // muParser's own name characters plus the dot of "Tool.Input".
    mImpl->parser.DefineNameChars("0123456789_.abcdefghijklmnopqrstuvwxyzABCDEFGHIJKLMNOPQRSTUVWXYZ");
}

Parser::~Parser() = default;

bool Parser::DefineVar(const char *name, float64 *storage)
{
    if (!name || !storage)
        return false;
    try {
        mImpl->parser.DefineVar(name, storage);
    } catch (const mu::Parser::exception_type &e) {
        mImpl->error = e.GetMsg();
        return false;
    }
    // A new binding drops muParser's byte code; rebuild it now rather than
    // on the next evaluation.
    if (mImpl->valid)
        mImpl->Compile();
    return true;
}

bool Parser::SetVar(const char *name, float64 value)
{
    if (!name)
        return false;
    auto found = mImpl->owned.find(name);
    if (found != mImpl->owned.end()) {
        found->second = value;
        return true;
    }
    float64 &slot = mImpl->owned[name];
    slot = value;
    if (DefineVar(name, &slot))
        return true;
    mImpl->owned.erase(name);
    return false;
}

float64 *Parser::GetVar(const char *name) const
{
    if (!name)
        return nullptr;
    const mu::varmap_type &vars = mImpl->parser.GetVar();
    auto found = vars.find(name);
    return found == vars.end() ? nullptr : found->second;
}

bool Parser::SetExpression(const char *text)
{
    mImpl->text = text ? text : "";
    return mImpl->Compile();
}

bool Parser::UsedNames(const char *text, std::vector<std::string> &names)
{
    names.clear();
    mImpl->valid = false;
    mImpl->text = text ? text : "";
    if (mImpl->text.empty()) {
        mImpl->error = "empty expression";
        return false;
    }
    try {
        mImpl->parser.SetExpr(mImpl->text);
        for (const auto &used : mImpl->parser.GetUsedVar())
            names.push_back(used.first);
        mImpl->error.clear();
        return true;
    } catch (const mu::Parser::exception_type &e) {
        mImpl->error = e.GetMsg();
        mImpl->text.clear();
        return false;
    }
}

const char *Parser::GetExpression() const
{
    return mImpl->text.c_str();
}

bool Parser::IsValid() const noexcept
{
    return mImpl->valid;
}

float64 Parser::Evaluate(bool *ok) const
{
    if (ok)
        *ok = false;
    if (!mImpl->valid)
        return std::numeric_limits<float64>::quiet_NaN();
    try {
        const float64 value = mImpl->parser.Eval();
        if (ok)
            *ok = true;
        return value;
    } catch (const mu::Parser::exception_type &e) {
        mImpl->error = e.GetMsg();
        return std::numeric_limits<float64>::quiet_NaN();
    }
}

const char *Parser::GetError() const
{
    return mImpl->error.c_str();
}

} // namespace Orbane
