#pragma once

#include "orbane/InputWatcher.h"
#include "orbane/LayoutContainer.h"
#include "orbane/LayoutWidgetMap.h"
#include "orbane/Object.h"
#include "orbane/OrbString.h"
#include "orbane/ScriptVal.h"

#include <QColor>
#include <QFont>
#include <QPointer>
#include <QWidget>

#include <memory>
#include <vector>

class QLineEdit;
class QMenu;

namespace Orbane {

class Input;
class OrbaneDoc;
class Parameter;

// Attributes every input control reads from SetAttrsTagList (the tool's
// Input attributes or a script's SetAttrs) besides its own.
enum InputControlTag : Tag
{
    ICA_Disabled = 0x10020030, // the control shows its value but takes no edits
    ICA_Passive = 0x10020031,  // Input attribute: a change needs no render
};

// The two roots of every inspector control, in this order: the host Object
// first, so that the script-visible root sits at the start of the object (the
// exported uncast functions rely on it), then QWidget. This class has no
// Q_OBJECT of its own; moc sees it as a QWidget subclass through its second base.
class _InputControl : public Object, public QWidget
{
public:
    _InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~_InputControl() override;
};

// The host base of every inspector control: one or more Inputs of a tool
// shown and edited in its inspector. The inspector drives a control through
//   AddInput (each Input) -> Open -> SetSize (again on every width change)
//   -> NotifyChanged / UpdateDisplay / SetAttrsTagList ... -> OnDisconnect
//   (each Input) -> destruction.
// Controls override the virtual operations and call the base at the point
// their contract gives. A user's edit is written with SetInputs, and the
// gesture's undo step is closed with ResetUndo: one gesture, one undo step.
//
// Expressions: each bound Input may have an expression field, a one-line
// edit placed in the layout's "expression" container. It stays hidden until
// the user asks for it (the context menu's "Expression") or an expression
// was entered, and it shows the Input's live expression whenever it has one
// (red, with the reason as its tip, where that cannot be evaluated). Return
// hands the text to the Input as its live expression (Input::SetExpression:
// `time`, `Size`, `Blur1.Size`), one undo step; a refused text stays in the
// red field with the reason as tip. A text naming `value` (the Input's number
// now) is a one-off calculation instead: evaluated once and written, the
// Input stays plain; the text stays in the field for the next edit.
class InputControl : public _InputControl, public InputWatcher
{
    Q_OBJECT
public:
    // Bits of the control flags word.
    enum ControlFlags : uint32
    {
        CF_ActionOnly = 1u << 1, // the control triggers an action (a button) rather than showing a value
    };

    InputControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~InputControl() override;

    std::size_t SizeOf() const override { return sizeof(InputControl); }
    // The label texts (LINKS_Name, LINKS_SecondName) and the disabled state.
    bool GetAttrsTagList(TagList &tags) const override;
    // A script's SetAttrs: the input-control form for the current Input.
    bool SetAttrsTagList(const TagList &tags) override;

    // --- the input-control operations, in their order ---
    // The Inputs the control shows at `pos` (its own coordinates).
    virtual QList<Input *> GetInputsAt(const QPoint &pos) const;
    // The tool or a script changed the control's attributes.
    virtual bool SetAttrsTagList(Input *input, const TagList &tags);
    // Makes the control ready to show inside `host` (the inspector page; may
    // be null where the caller places the control itself).
    virtual bool Open(QWidget *host, const QRect &rect, const TagList *tags);
    virtual void Close(const TagList *tags);
    virtual QSize GetMinSize(const TagList *tags) const;
    virtual QSize GetMaxSize(const TagList *tags) const;
    // Lays the children out for the width offered, answers the height used
    // and gives the control that size.
    virtual bool SetSize(int32 &width, int32 &height, const TagList *tags);
    // Starts and stops watching an Input's value.
    virtual bool AttachInput(Input *input, const TagList *tags);
    virtual bool DetachInput(Input *input, const TagList *tags);
    // Binds an Input (one reference, watched); false where it cannot be
    // bound (null, or bound already).
    virtual bool AddInput(Input *input, const TagList *tags);
    // Unbinds without writing anything; false where it was not bound.
    virtual bool RemoveInput(Input *input, const TagList *tags);
    // Writes a user's value to every bound Input at `time`; refused (false)
    // while the tool is locked. The first write of a gesture opens its undo
    // step, named by SetUndo, else "Change <label>". A `quiet` write does not
    // notify this control itself (the others bound to the Inputs are told).
    virtual bool SetInputs(Parameter *value, float64 time, uint32 flags, bool quiet, const TagList *tags);
    // Closes the undo step the current gesture opened, if any.
    virtual void ResetUndo(const TagList *tags);
    // An Input's value may have changed; the base redisplays.
    virtual bool NotifyChanged(Input *input, Parameter *value, const TagList *tags);
    // Shows the cached value again; the base applies the disabled state and
    // repaints the control and its registered children.
    virtual bool UpdateDisplay(Input *input, const TagList *tags);
    virtual bool OnConnect(Input *input, const TagList *tags);
    // The Input is being unbound; the base stops watching it and lets it go.
    virtual bool OnDisconnect(Input *input, const TagList *tags);
    virtual bool HasFocus() const;
    virtual Input *GetInputFrom(const QWidget *child) const;
    // Names the undo step of the next gesture (null: back to "Change <label>").
    virtual void SetUndo(const char *name, const TagList *tags);
    // The user asks for Input `index`'s expression field: it is made where
    // needed, shown and focused. False where there is no such Input.
    virtual bool AddExpressionEdit(int32 index, const TagList *tags);
    // Makes Input `index`'s field at `rect`, outside any layout.
    virtual QLineEdit *CreateExpressionEdit(const QRect &rect, int32 index);
    // Places Input `index`'s expression field in the container (the
    // description's "expression" place); hidden while there is no expression.
    virtual QLineEdit *CreateExpressionEdit(Layout::Container *where, int32 index);
    // The expression text of Input `index` (empty where none).
    virtual OrbString GetExpressionData(int32 index) const;
    virtual QRect GetExpressionRect(int32 index) const;
    // Evaluates `text` for Input `index` and writes the result; an empty
    // text removes the expression and hides the field.
    virtual bool ExpressionChanged(int32 index, const char *text);
    // Removes Input `index`'s expression and hides its field.
    virtual bool RemoveExpressionAt(int32 index);
    // Enter and Escape in an expression field.
    virtual void OnOK();
    virtual void OnCancel();
    // Entries of the control's context menu; the base offers "Expression".
    virtual void AddToMenu(QMenu *menu);

    // --- what controls use of the base ---
    // Builds the layout from a class layout description with the children
    // registered so far. Without `replace`, an existing layout is kept
    // (false). `hook` is reserved and must be null.
    bool CreateLayout(const ScriptVal &description, bool replace, void *hook);
    // Reads a look-pack layout item (key 1 of its table) and creates it.
    bool LoadLayout(const char *itemName);
    Layout::LayoutObj *FindLayoutObj(const char *name) const;
    Layout::Container *GetLayout() const { return mLayout.get(); }
    // Offers a child to the layout under a fixed name ("label", "checkbox").
    void RegisterChild(const char *name, QWidget *child);
    // Hands a typed expression to every bound Input; false where it does
    // not evaluate for one of them.
    bool SetExpressions(const char *text, const TagList *tags);

    // The layout description in the look-pack item `itemName` (key 1 of its
    // table), nil where there is none.
    static ScriptVal ReadLayoutItem(const char *itemName);

    // Does a notified value differ from the one shown? With integer display
    // two values that round to the same integer are the same; otherwise they
    // must differ by more than `tolerance`.
    static bool HasValueChanged(bool integer, float64 value, float64 current, float64 tolerance);
    // The disabled state a tag list gives the control (ICA_Disabled), or
    // `current` where the list says nothing of it.
    static bool GetDisabledTags(const TagList &tags, bool current);

    // The label rule: tag 0x30040000 of the Input's attributes, else
    // 0x30020014, else the Input's identifier.
    static OrbString LabelOf(const Input *input);
    // Tag 0x30040001, empty where absent.
    static OrbString SecondLabelOf(const Input *input);

    virtual QColor GetBackgroundColor() const;
    // The document of the control's tool; null while no Input is bound.
    virtual OrbaneDoc *GetDoc() const;
    // The time the control shows and writes at: the document's current time.
    float64 GetCurrentTime() const;
    Input *GetCurrentInput() const { return mInputs.empty() ? nullptr : mInputs.front(); }
    const std::vector<Input *> &Inputs() const { return mInputs; }
    bool IsOpen() const { return mOpen; }
    bool IsDisabled() const { return mDisabled; }
    void SetDisabled(bool disabled);
    const QFont &GetControlFont() const { return mControlFont; }
    uint32 GetControlFlags() const { return mFlags; }
    void SetControlFlags(uint32 flags) { mFlags = flags; }
    // Do all bound Inputs take effect without a render (ICA_Passive)?
    virtual bool AllInputsPassive() const;
    // Is the tool of a bound Input locked against edits?
    bool IsLocked() const;
    // Is a gesture's undo step open?
    bool IsUndoOpen() const { return mUndoOpen; }
    // The field of Input `index`, or null where none was made.
    QLineEdit *GetExpressionEdit(int32 index) const;

    bool hasHeightForWidth() const override;
    int heightForWidth(int width) const override;
    QSize sizeHint() const override;

    static const OrbID ClassID;

protected:
    void OnInputChanged(Input *input, Parameter *value, const TagList *tags) final;
    void resizeEvent(QResizeEvent *event) override;
    void contextMenuEvent(QContextMenuEvent *event) override;
    bool eventFilter(QObject *watched, QEvent *event) override;

    uint32 mFlags = 0;

private slots:
    void OnExpressionEntered();
    void OnExpressionMenu();

private:
    OrbString UndoName() const;
    void OpenUndo();
    int32 IndexOf(const QObject *edit) const;
    QLineEdit *MakeExpressionEdit(int32 index);
    void Relayout();
    bool WriteExpression(int32 index, float64 value);
    bool EvaluateOnce(int32 index, const char *text);
    // The field of Input `index`, made and placed where there was none.
    QLineEdit *EnsureExpressionEdit(int32 index);
    // Shows `text` in the field (unless the user is typing there), red with
    // `error` as tip where that is not empty.
    void ShowExpression(int32 index, const char *text, const QString &error);
    void HideExpressionField(int32 index);
    // Follows the live expression of `input` and its error into the fields.
    void SyncExpression(Input *input);

    std::vector<Input *> mInputs; // one reference each
    bool mOpen = false;
    bool mDisabled = false;
    bool mUndoOpen = false;
    bool mQuietWrite = false;
    int32 mArrangedWidth = -1;
    int32 mArrangedHeight = -1;
    OrbString mUndoName;
    QPointer<OrbaneDoc> mUndoDoc;
    QFont mControlFont;
    Layout::WidgetMap mChildren;
    std::unique_ptr<Layout::Container> mLayout;
    std::vector<QPointer<QLineEdit>> mExpressionEdits; // by Input index
    std::vector<OrbString> mExpressions;               // by Input index
    // By Input index: the live expression and error of the Input last shown.
    struct ShownExpression
    {
        OrbString text;
        OrbString error;
    };
    std::vector<ShownExpression> mShown;
};

} // namespace Orbane
