#pragma once
// Message boxes and input boxes. Every text and title the user sees goes through here, so
// tests can script the answers and read back exactly what was shown.
#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::platform {

enum class Buttons { Ok, OkCancel, YesNo, YesNoCancel, RetryCancel };
enum class Icon { None, Information, Exclamation, Question, Critical };
enum class Answer { Ok, Cancel, Yes, No, Retry };

class Dialogs {
public:
    virtual ~Dialogs() = default;
    virtual Answer MsgBox(std::string_view text, std::string_view title,
                          Buttons buttons = Buttons::Ok, Icon icon = Icon::None) = 0;
    // nullopt when the user cancels.
    virtual std::optional<std::string> InputBox(std::string_view prompt, std::string_view title,
                                                std::string_view defaultText = {}) = 0;
    virtual void Beep() = 0;
    // Busy pointer on long work; a no-op where there is no pointer.
    virtual void SetBusy(bool /*busy*/) {}
};

// Answers from a queue and a transcript of everything shown: the tests' window.
class ScriptedDialogs : public Dialogs {
public:
    struct Shown {
        std::string kind; // "msg", "input", "beep"
        std::string text;
        std::string title;
        Buttons buttons = Buttons::Ok;
    };

    void QueueAnswer(Answer a) { m_answers.push_back(a); }
    void QueueInput(std::optional<std::string> text) { m_inputs.push_back(std::move(text)); }

    Answer MsgBox(std::string_view text, std::string_view title, Buttons buttons,
                  Icon icon) override;
    std::optional<std::string> InputBox(std::string_view prompt, std::string_view title,
                                        std::string_view defaultText) override;
    void Beep() override { m_shown.push_back({"beep", "", "", Buttons::Ok}); }

    const std::vector<Shown>& shown() const { return m_shown; }
    std::vector<std::string> messages() const; // texts of message boxes in order
    void clear() { m_shown.clear(); }

private:
    std::deque<Answer> m_answers;
    std::deque<std::optional<std::string>> m_inputs;
    std::vector<Shown> m_shown;
};

// For the command-line tool: messages go to standard error; questions take their default
// (the first button) unless standard input is a terminal.
class ConsoleDialogs : public Dialogs {
public:
    explicit ConsoleDialogs(bool interactive) : m_interactive(interactive) {}
    Answer MsgBox(std::string_view text, std::string_view title, Buttons buttons,
                  Icon icon) override;
    std::optional<std::string> InputBox(std::string_view prompt, std::string_view title,
                                        std::string_view defaultText) override;
    void Beep() override;

private:
    bool m_interactive;
};

} // namespace kori::platform
