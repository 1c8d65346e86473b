#pragma once
// ChtOptions ("Viewing Options"): the full list or one of the chart lists.
#include <QDialog>

#include <array>

#include <optional>
#include <string>
#include <utility>

class QListWidget;

namespace kori::gui {

class ChtOptions : public QDialog {
    Q_OBJECT
public:
    // `names`: the display names of the ten chart lists A..K.
    ChtOptions(const std::array<std::string, 10>& names, QWidget* parent = nullptr);
    QListWidget* list() const { return m_list; }
    // The picked list mode and display name, or nullopt when nothing was picked.
    std::optional<std::pair<int, std::string>> Picked() const;

private:
    QListWidget* m_list;
};

} // namespace kori::gui
