#pragma once
// CHTPage: where the chart sits on paper (the printer origin) and the orientation. An origin
// of 0 centres the chart on the next print.
#include "app/session.h"

#include <QDialog>

class QSpinBox;
class QComboBox;

namespace kori::gui {

class CHTPage : public QDialog {
    Q_OBJECT
public:
    explicit CHTPage(app::Session& session, QWidget* parent = nullptr);
    // Stores the values in the session and Kori.ini.
    void Save();

private:
    app::Session& m_session;
    QSpinBox* m_left;
    QSpinBox* m_top;
    QComboBox* m_orient;
};

} // namespace kori::gui
