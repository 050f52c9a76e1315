// Base of the models behind dialogs: how a model talks to the person, without any widget.
#pragma once

#include <string>
#include <vector>

namespace zql::frx {

class MDialog;

/// Of a question with three answers.
enum class ANSWER { Yes, No, Cancel };

/// What stands between a dialog model and the person: a window, a script of answers, or stderr.
class IDialogView {
public:
    IDialogView() = default;
    IDialogView(const IDialogView&) = delete;
    IDialogView& operator=(const IDialogView&) = delete;
    virtual ~IDialogView() = default;
    /// Shows a message; a window waits until it is read.
    virtual void ShowMessage(const std::string& key, const std::string& text) = 0;
    /// True: yes.
    virtual bool AskYesNo(const std::string& key, const std::string& text) = 0;
    /// A view that offers no third answer takes a no for a cancel: nothing is lost by it.
    virtual ANSWER AskYesNoCancel(const std::string& key, const std::string& text)
    {
        return AskYesNo(key, text) ? ANSWER::Yes : ANSWER::Cancel;
    }
    /// Shows a child dialog; 1 accepted, 0 cancelled.
    virtual int RunModal(MDialog& child) = 0;
    /// Handles what has come in while a long operation runs, except closing the window and system
    /// commands. Nothing by default.
    virtual void DispatchEvents() {}
};

/// A message that a dialog has shown.
struct T_MESSAGE {
    std::string key;  // message key
    std::string text; // text as shown
    bool operator==(const T_MESSAGE&) const = default;
};

/// A dialog without a widget: it keeps its messages, and asks the person through its view.
class MDialog {
public:
    MDialog() = default;
    MDialog(const MDialog&) = delete;
    MDialog& operator=(const MDialog&) = delete;
    virtual ~MDialog() = default;

    /// The view is not owned and must outlive the dialog or be reset to null.
    void SetView(IDialogView* view) { m_view = view; }
    /// Null: none, then questions are answered with no.
    IDialogView* View() const { return m_view; }

    /// Every message shown so far, oldest first.
    const std::vector<T_MESSAGE>& Messages() const { return m_messages; }
    /// Forgets the messages shown so far.
    void ClearMessages() { m_messages.clear(); }

    /// The one pass over the dialog's data before it is accepted. 1 when all is well.
    virtual int CheckData() { return 1; }
    /// Accepts the dialog when its data pass. 1 accepted; 0 stays open.
    virtual int OnOK() { return CheckData(); }

    /// Runs this dialog in the installed view; without a view it is refused (0).
    int DoModal();

protected:
    /// Keeps the message and shows it in the view, if any. The text comes from the catalogue.
    void ShowMessage(const std::string& key);
    /// The same with a text whose places are filled.
    void ShowMessage(const std::string& key, const std::string& text);
    /// Asks the person; without a view the answer is no (nothing is guessed).
    bool AskYesNo(const std::string& key);
    /// The same with a text whose places are filled.
    bool AskYesNo(const std::string& key, const std::string& text);
    /// Without a view: cancel.
    ANSWER AskYesNoCancel(const std::string& key, const std::string& text);

private:
    IDialogView* m_view = nullptr;
    std::vector<T_MESSAGE> m_messages;
};

} // namespace zql::frx
