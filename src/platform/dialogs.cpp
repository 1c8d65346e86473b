#include "platform/dialogs.h"

#include "platform/text.h"

#include <iostream>

namespace kori::platform {

namespace {
Answer DefaultAnswer(Buttons b) {
    switch (b) {
    case Buttons::Ok:
    case Buttons::OkCancel:
        return Answer::Ok;
    case Buttons::YesNo:
    case Buttons::YesNoCancel:
        return Answer::Yes;
    case Buttons::RetryCancel:
        return Answer::Retry;
    }
    return Answer::Ok;
}
} // namespace

Answer ScriptedDialogs::MsgBox(std::string_view text, std::string_view title, Buttons buttons,
                               Icon) {
    m_shown.push_back({"msg", std::string(text), std::string(title), buttons});
    if (m_answers.empty()) return DefaultAnswer(buttons);
    const Answer a = m_answers.front();
    m_answers.pop_front();
    return a;
}

std::optional<std::string> ScriptedDialogs::InputBox(std::string_view prompt,
                                                     std::string_view title,
                                                     std::string_view defaultText) {
    m_shown.push_back({"input", std::string(prompt), std::string(title), Buttons::OkCancel});
    if (m_inputs.empty()) return std::string(defaultText);
    auto a = m_inputs.front();
    m_inputs.pop_front();
    return a;
}

std::vector<std::string> ScriptedDialogs::messages() const {
    std::vector<std::string> r;
    for (const auto& s : m_shown)
        if (s.kind == "msg") r.push_back(s.text);
    return r;
}

Answer ConsoleDialogs::MsgBox(std::string_view text, std::string_view title, Buttons buttons,
                              Icon) {
    std::cerr << title << ": " << Trim(text) << "\n";
    if (!m_interactive || buttons == Buttons::Ok) return DefaultAnswer(buttons);
    const bool yesNo = buttons == Buttons::YesNo || buttons == Buttons::YesNoCancel;
    std::cerr << (yesNo ? "[y/n] " : "[o/c] ") << std::flush;
    std::string line;
    if (!std::getline(std::cin, line)) return Answer::Cancel;
    const std::string a = Upper(Trim(line));
    if (yesNo) {
        if (a.starts_with("Y")) return Answer::Yes;
        if (a.starts_with("N")) return Answer::No;
        return buttons == Buttons::YesNoCancel ? Answer::Cancel : Answer::No;
    }
    return a.starts_with("C") ? Answer::Cancel : DefaultAnswer(buttons);
}

std::optional<std::string> ConsoleDialogs::InputBox(std::string_view prompt, std::string_view title,
                                                    std::string_view defaultText) {
    std::cerr << title << ": " << Trim(prompt);
    if (!m_interactive) {
        std::cerr << "\n";
        return std::nullopt;
    }
    std::cerr << " [" << defaultText << "] " << std::flush;
    std::string line;
    if (!std::getline(std::cin, line)) return std::nullopt;
    if (line.empty()) return std::string(defaultText);
    return line;
}

void ConsoleDialogs::Beep() {
    std::cerr << '\a' << std::flush;
}

} // namespace kori::platform
