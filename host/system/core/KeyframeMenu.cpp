#include "orbane/KeyframeMenu.h"

#include "orbane/AutoParam.h"
#include "orbane/Input.h"
#include "orbane/OrbaneDoc.h"

#include <QMenu>

#include <functional>

namespace Orbane {

namespace {

// Runs `edit` as one undo step named `name`; a plain call outside a document.
bool AsOneStep(Input *input, const char *name, const std::function<bool()> &edit)
{
    OrbaneDoc *doc = input->GetDoc();
    if (doc)
        doc->StartUndo(name);
    const bool done = edit();
    if (doc)
        doc->EndUndo();
    return done;
}

void AddEntry(QMenu *menu, const char *text, bool enabled, const std::function<void()> &run)
{
    QAction *action = menu->addAction(QString::fromUtf8(text));
    action->setEnabled(enabled);
    QObject::connect(action, &QAction::triggered, menu, run);
}

} // namespace

bool KeyframeMenu::HasKeyNow(const Input *input)
{
    const AutoParameter key(input->GetKey(input->CurrentTime()));
    return input->IsAnimated() && key;
}

bool KeyframeMenu::SetKey(Input *input)
{
    return AsOneStep(input, kSetKey, [input] {
        if (!input->IsAnimated())
            return input->Animate(true);
        const float64 now = input->CurrentTime();
        const AutoParameter value(input->GetValue(now));
        return value && input->SetValue(value, now);
    });
}

bool KeyframeMenu::RemoveKey(Input *input)
{
    if (!HasKeyNow(input))
        return false;
    return AsOneStep(input, kRemoveKey, [input] {
        // Without any key the Input would fall back to a stale plain value;
        // the last key's value stays as the plain one instead.
        if (input->KeyTimes().size() == 1)
            return input->Animate(false);
        return input->RemoveKey(input->CurrentTime());
    });
}

void KeyframeMenu::AddTo(QMenu *menu, Input *input, bool locked)
{
    if (!menu || !input)
        return;
    const bool animated = input->IsAnimated();
    AddEntry(menu, kSetKey, !locked, [input] { SetKey(input); });
    AddEntry(menu, kRemoveKey, !locked && HasKeyNow(input), [input] { RemoveKey(input); });
    AddEntry(menu, animated ? kRemoveAnimation : kAnimate, !locked, [input, animated] {
        AsOneStep(input, animated ? kRemoveAnimation : kAnimate,
                  [input, animated] { return input->Animate(!animated); });
    });
    menu->addSeparator();
}

} // namespace Orbane
