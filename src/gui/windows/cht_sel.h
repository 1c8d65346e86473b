#pragma once
// ChtSel ("Chart Selection Menu"): picks the security, list, style, period, spacing, bands,
// oscillator, averages, volume and finish date of the next chart. Every rule is in
// app::ChartSelection; this window shows its form and passes the user's actions on.
#include "app/chart_selection.h"

#include <QWidget>

class QComboBox;
class QCheckBox;
class QLabel;
class QLineEdit;
class QPushButton;
class QScrollBar;
class QToolButton;

namespace kori::gui {

class ChtSel : public QWidget {
    Q_OBJECT
public:
    ChtSel(app::Session& session, app::ChartState& state, QWidget* parent = nullptr);

    // First load; false when the data folder cannot be read.
    bool Load();
    // Activation: after "Change List", reopen the list.
    void Activate();
    app::ChartSelection& selection() { return m_sel; }
    // Shows or hides "Change Folder" and "Set Defaults" by what the program has to open.
    void SetFolderButton(bool shown);
    void SetDefaultsButton(bool shown);

    // The buttons' work, callable from tests.
    void ShowChart();
    void CloseWindow();
    void ChangeList();
    // Double click in a class field: the class window in its pick mode chooses the code.
    void PickClassCode(bool gics);

signals:
    void ShowChartRequested();
    void CloseRequested();
    void ChangeFolderRequested();
    void SetDefaultsRequested();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void Refresh();
    void CodeEntered();
    void NameEntered();
    void BandsChosen(int index);
    void ClassBoxTicked(bool gics, bool on);
    void ClassCodeEntered(bool gics);

    app::Session& m_session;
    app::ChartSelection m_sel;
    bool m_updating = false;

    QLabel* m_listCaption;
    QLineEdit* m_code;
    QLineEdit* m_name;
    QLabel* m_total;
    QLabel* m_this;
    QScrollBar* m_scroll;
    QComboBox* m_style;
    QComboBox* m_osc;
    QComboBox* m_bands;
    QComboBox* m_period;
    QLabel* m_spacingCaption;
    QLineEdit* m_spacing;
    QToolButton* m_up;
    QToolButton* m_down;
    QLineEdit* m_finish;
    QPushButton* m_volume;
    QCheckBox* m_av1;
    QCheckBox* m_av2;
    QCheckBox* m_classBox;
    QLineEdit* m_classCode;
    QCheckBox* m_gicsBox;
    QLineEdit* m_gicsCode;
    QPushButton* m_folder;
    QPushButton* m_defaults;
};

} // namespace kori::gui
