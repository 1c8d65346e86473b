#pragma once
// Search: finds, one after another, the securities of the full list whose code or name holds
// the text typed; each find is handed to the chart selection.
#include "store/name_record.h"

#include <QDialog>

#include <functional>
#include <vector>

class QLineEdit;
class QPushButton;

namespace kori::platform {
class Dialogs;
}

namespace kori::gui {

class Search : public QDialog {
    Q_OBJECT
public:
    Search(const std::vector<store::NameRecord>& names, int fromPosition,
           platform::Dialogs& dialogs, std::function<void(int)> found, QWidget* parent = nullptr);
    QLineEdit* field() const { return m_field; }
    // "Find Next": shows the next match, or "No more matches" when the walk ends.
    void FindNext();

private:
    const std::vector<store::NameRecord>& m_names;
    int m_position;
    platform::Dialogs& m_dialogs;
    std::function<void(int)> m_found;
    QLineEdit* m_field;
};

} // namespace kori::gui
