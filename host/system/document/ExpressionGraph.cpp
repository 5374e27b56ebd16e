#include "ExpressionGraph.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <unordered_set>

namespace Orbane {

namespace {

constexpr std::size_t kNoOrder = std::numeric_limits<std::size_t>::max();
const char kTimeName[] = "time";

std::string Label(const Input *in)
{
    const Operator *tool = in->GetOperator();
    return (tool ? std::string(tool->GetName()) + "." : std::string()) + in->GetID().c_str();
}

float64 NumberAt(Input *in, float64 time)
{
    const AutoNumber number(in, time);
    return number ? number->Value : 0.0;
}

} // namespace

// One expression, compiled once; its variables live in `values`, which the
// parser reads by address, in the order of `names`.
struct ExpressionGraph::Node
{
    Input *input = nullptr;
    std::string text;
    Parser parser;
    std::vector<std::string> names;
    std::unique_ptr<float64[]> values;
    std::vector<Input *> sources; // by name; null for the time
    std::string fixedError;       // from resolving and sorting: no evaluation
    std::size_t order = kNoOrder;

    bool Compile(const char *expression)
    {
        text = expression;
        if (!parser.UsedNames(expression, names))
            return false;
        values = std::make_unique<float64[]>(names.size());
        for (std::size_t i = 0; i < names.size(); ++i)
            if (!parser.DefineVar(names[i].c_str(), &values[i]))
                return false;
        return parser.SetExpression(expression);
    }

    bool Compute(float64 time, float64 *result)
    {
        for (std::size_t i = 0; i < sources.size(); ++i)
            values[i] = sources[i] ? NumberAt(sources[i], time) : time;
        bool ok = false;
        *result = parser.Evaluate(&ok);
        return ok && std::isfinite(*result);
    }
};

ExpressionGraph::ExpressionGraph(OrbaneDoc &doc) : mDoc(doc) {}

ExpressionGraph::~ExpressionGraph() = default;

Input *ExpressionGraph::Find(const Input *owner, const std::string &name) const
{
    const std::size_t dot = name.find('.');
    if (dot == std::string::npos) {
        const Operator *tool = owner->GetOperator();
        return tool ? tool->FindInput(OrbID(name)) : nullptr;
    }
    const Operator *tool = mDoc.FindTool(name.substr(0, dot).c_str());
    return tool ? tool->FindInput(OrbID(name.substr(dot + 1))) : nullptr;
}

void ExpressionGraph::Resolve(Node &node) const
{
    node.sources.assign(node.names.size(), nullptr);
    node.fixedError.clear();
    for (std::size_t i = 0; i < node.names.size(); ++i) {
        if (node.names[i] == kTimeName)
            continue;
        Input *source = Find(node.input, node.names[i]);
        if (!source || source->GetDataType() != CLSID_DataType_Number) {
            if (node.fixedError.empty())
                node.fixedError =
                    (source ? "Input \"" + node.names[i] + "\" holds no number" : "no Input \"" + node.names[i] + "\"");
            continue;
        }
        node.sources[i] = source;
    }
}

std::string ExpressionGraph::Try(const Input *owner, const char *text, float64 *value)
{
    EnsureBuilt();
    Node trial;
    trial.input = const_cast<Input *>(owner); // resolved against, never written
    if (!trial.Compile(text))
        return trial.parser.GetError();
    Resolve(trial);
    if (!trial.fixedError.empty())
        return trial.fixedError;
    // Would the new expression read, through others, its own Input? Walk the
    // sources depth first, remembering who led where for the message.
    std::unordered_map<const Input *, const Input *> cameFrom;
    std::vector<const Input *> stack;
    for (const Input *source : trial.sources)
        if (source && cameFrom.emplace(source, owner).second)
            stack.push_back(source);
    while (!stack.empty()) {
        const Input *at = stack.back();
        stack.pop_back();
        if (at == owner) {
            std::string path = Label(owner);
            for (const Input *step = cameFrom[owner]; step != owner; step = cameFrom[step])
                path = Label(step) + " -> " + path;
            return "cycle: " + Label(owner) + " -> " + path;
        }
        const auto found = mNodes.find(at);
        if (found == mNodes.end())
            continue;
        for (const Input *source : found->second->sources)
            if (source && cameFrom.emplace(source, at).second)
                stack.push_back(source);
    }
    if (!trial.Compute(mDoc.GetCurrentTime(), value))
        return "the result is not a number";
    return std::string();
}

void ExpressionGraph::ToolsChanged()
{
    mDirty = true;
    if (!mBusy)
        EvaluateAll();
}

void ExpressionGraph::EnsureBuilt()
{
    if (mDirty && !mBusy)
        Rebuild();
}

std::unique_ptr<ExpressionGraph::Node> ExpressionGraph::TakeOrCompile(Input *in)
{
    const auto old = mNodes.find(in);
    if (old != mNodes.end() && old->second->text == in->GetExpression())
        return std::move(old->second);
    auto node = std::make_unique<Node>();
    node->input = in;
    if (!node->Compile(in->GetExpression()))
        node->fixedError = node->parser.GetError();
    return node;
}

void ExpressionGraph::Rebuild()
{
    mDirty = false;
    std::unordered_map<const Input *, std::unique_ptr<Node>> nodes;
    std::vector<Node *> all; // in document order, so sorting is stable
    for (const Operator *tool : mDoc.Tools())
        for (Input *in : tool->Inputs())
            if (in->HasExpression()) {
                std::unique_ptr<Node> node = TakeOrCompile(in);
                all.push_back(node.get());
                nodes[in] = std::move(node);
            }
    mNodes = std::move(nodes);
    for (Node *node : all)
        if (node->values) // compiled
            Resolve(*node);
    mOrder = std::move(all);
    Sort();
    for (const auto &entry : mNodes)
        if (!entry.second->fixedError.empty())
            SetError(*entry.second, entry.second->fixedError);
    // Expressions healed by this change (their cycle broken, the Input they
    // named back) follow at once; their readers follow them.
    std::vector<Node *> healed;
    for (Node *node : mOrder)
        if (node->fixedError.empty() && *node->input->GetExpressionError())
            healed.push_back(node);
    for (Node *node : healed)
        Evaluate(*node);
}

// Kahn's algorithm: a node is placed once every expression it reads is.
// Nodes never placed are in a cycle or read one.
void ExpressionGraph::Sort()
{
    std::vector<Node *> all = std::move(mOrder);
    mOrder.clear();
    mReaders.clear();
    std::unordered_map<const Node *, std::size_t> waiting;
    for (Node *node : all) {
        node->order = kNoOrder;
        waiting[node] = 0;
        for (Input *source : node->sources)
            if (source) {
                mReaders[source].push_back(node);
                waiting[node] += mNodes.count(source);
            }
    }
    std::vector<Node *> ready;
    for (auto it = all.rbegin(); it != all.rend(); ++it)
        if (waiting[*it] == 0)
            ready.push_back(*it);
    while (!ready.empty()) {
        Node *node = ready.back();
        ready.pop_back();
        node->order = mOrder.size();
        mOrder.push_back(node);
        for (Node *reader : mReaders[node->input])
            if (--waiting[reader] == 0)
                ready.push_back(reader);
    }
    std::vector<Node *> left;
    for (Node *node : all)
        if (node->order == kNoOrder)
            left.push_back(node);
    MarkCycles(left);
}

// Every unplaced node reads an unplaced node, so walking from one to a
// source among them always ends on a node seen before: a cycle. Its members
// say so; the nodes that led to it read a cycle.
void ExpressionGraph::MarkCycles(std::vector<Node *> &left)
{
    std::unordered_set<const Node *> unplaced(left.begin(), left.end());
    std::unordered_set<const Node *> marked;
    for (Node *start : left) {
        if (marked.count(start))
            continue;
        std::vector<Node *> path{start};
        std::string leadsTo;
        for (;;) {
            Node *next = nullptr;
            for (Input *source : path.back()->sources)
                if (const auto found = mNodes.find(source);
                    found != mNodes.end() && unplaced.count(found->second.get()))
                    next = found->second.get();
            if (!next) // cannot happen: an unplaced node always reads one
                break;
            const auto seen = std::find(path.begin(), path.end(), next);
            if (marked.count(next)) {
                leadsTo = Label(next->input);
                break;
            }
            if (seen != path.end()) {
                std::string cycle = Label((*seen)->input);
                for (auto it = seen + 1; it != path.end(); ++it)
                    cycle += " -> " + Label((*it)->input);
                cycle += " -> " + Label((*seen)->input);
                for (auto it = seen; it != path.end(); ++it) {
                    (*it)->fixedError = "cycle: " + cycle;
                    marked.insert(*it);
                }
                leadsTo = Label((*seen)->input);
                path.erase(seen, path.end());
                break;
            }
            path.push_back(next);
        }
        for (Node *node : path) {
            node->fixedError = "reads a cycle through " + leadsTo;
            marked.insert(node);
        }
    }
}

void ExpressionGraph::SetError(Node &node, std::string error)
{
    if (node.input->mExpressionError == error)
        return;
    node.input->mExpressionError = std::move(error);
    node.input->Notify();
}

void ExpressionGraph::Evaluate(Node &node)
{
    if (!node.fixedError.empty())
        return;
    Input *in = node.input;
    if (in->IsAnimated()) {
        SetError(node, "animated: its keys set the value");
        return;
    }
    const float64 time = mDoc.GetCurrentTime();
    float64 value = 0.0;
    if (!node.Compute(time, &value)) {
        SetError(node, "the result is not a number");
        return;
    }
    SetError(node, std::string());
    AutoNumber number(value);
    in->StoreValue(number, time, SETVALUE_NoUndo, nullptr);
}

void ExpressionGraph::EvaluateAll()
{
    if (mBusy)
        return;
    EnsureBuilt();
    mBusy = true;
    // A watcher told of a value may remove a tool; its Inputs stay alive
    // until the pass is over (the nodes stay: nothing rebuilds while busy).
    std::vector<AutoRef<Input>> hold;
    hold.reserve(mOrder.size());
    for (Node *node : mOrder) {
        hold.push_back(AutoRef<Input>::Share(node->input));
        Evaluate(*node);
    }
    mBusy = false;
}

void ExpressionGraph::ValueChanged(const Input *in)
{
    if (mBusy || (!mDirty && !mReaders.count(in)))
        return;
    EnsureBuilt();
    const auto readers = mReaders.find(in);
    if (readers == mReaders.end())
        return;
    // Readers come after their sources in the order, so one sweep from the
    // first marked node reaches everything downstream.
    std::vector<char> marked(mOrder.size(), 0);
    std::size_t first = mOrder.size();
    for (const Node *reader : readers->second)
        if (reader->order != kNoOrder) {
            marked[reader->order] = 1;
            first = std::min(first, reader->order);
        }
    mBusy = true;
    std::vector<AutoRef<Input>> hold;
    for (std::size_t i = first; i < mOrder.size(); ++i) {
        if (!marked[i])
            continue;
        Node &node = *mOrder[i];
        hold.push_back(AutoRef<Input>::Share(node.input));
        Evaluate(node);
        if (const auto next = mReaders.find(node.input); next != mReaders.end())
            for (const Node *reader : next->second)
                if (reader->order != kNoOrder)
                    marked[reader->order] = 1;
    }
    mBusy = false;
}

} // namespace Orbane
