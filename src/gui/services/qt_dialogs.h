#pragma once
// Message and input boxes of the desktop program.
#include "platform/dialogs.h"

class QWidget;

namespace kori::gui {

class QtDialogs : public platform::Dialogs {
public:
    explicit QtDialogs(QWidget* parent = nullptr) : m_parent(parent) {}
    void SetParent(QWidget* parent) { m_parent = parent; }

    platform::Answer MsgBox(std::string_view text, std::string_view title,
                            platform::Buttons buttons, platform::Icon icon) override;
    std::optional<std::string> InputBox(std::string_view prompt, std::string_view title,
                                        std::string_view defaultText) override;
    void Beep() override;
    void SetBusy(bool busy) override;

private:
    QWidget* m_parent;
    int m_busyDepth = 0;
};

} // namespace kori::gui
