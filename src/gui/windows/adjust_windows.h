#pragma once
// The manual adjustment windows: `Adjust` ("Adjustments for Issues") picks the security and the
// kind of issue; one entry window per kind (`AdjustB`, `AdjustC`, `AdjustSS`, `AdjustCC`,
// `AdjustD`) takes the terms and the day; `AdjDate` shows the records around the day;
// `AdjustR` removes the latest adjustment. The rules are in app::AdjustSelection and
// app::AdjustmentEntry; these only show them.
#include "app/session.h"
#ifndef Q_MOC_RUN
// The currency header's standard-library comparisons are beyond moc's parser.
#include "app/adjustment_forms.h"
#endif

#include <QDialog>
#include <QPointer>

#include <memory>

class QLabel;
class QLineEdit;
class QListWidget;
class QPushButton;
class QToolButton;

namespace kori::gui {

class MainWindow;

class AdjDate : public QDialog {
    Q_OBJECT
public:
    // Lists the records of the choice with the result selected; each pick goes to `entry`.
    AdjDate(app::AdjustmentEntry& entry, QWidget* parent);
    QListWidget* list() const { return m_list; }

signals:
    void chosen();

private:
    app::AdjustmentEntry& m_entry;
    QListWidget* m_list;
};

class AdjustEntry : public QDialog {
    Q_OBJECT
public:
    AdjustEntry(app::Session& session, app::AdjustmentInputs& inputs, adjust::AdjType type,
                QWidget* parent);

    app::AdjustmentEntry& model() { return m_model; }
    QLineEdit* fieldA() const { return m_a; }
    QLineEdit* fieldB() const { return m_b; }
    QLineEdit* fieldMoney() const { return m_money; }
    QLineEdit* fieldDate() const { return m_date; }
    QPushButton* dateButton() const { return m_dateButton; }
    QPushButton* adjustButton() const { return m_adjust; }
    QLabel* ratioLabel() const { return m_ratio; }
    QLabel* closeLabel() const { return m_close; }
    QLabel* descLabel() const { return m_desc; }
    AdjDate* dateWindow() const { return m_dateWindow; }

    // The date field's button and "Adjust Data".
    void RunDateStep();
    void RunAdjustData();

private:
    void TakeFields();
    void ShowReadOut();
    QLineEdit* Field(const char* name);

    app::AdjustmentEntry m_model;
    QLineEdit* m_a = nullptr;
    QLineEdit* m_b = nullptr;
    QLineEdit* m_money = nullptr;
    QLineEdit* m_date = nullptr;
    QPushButton* m_dateButton = nullptr;
    QPushButton* m_adjust = nullptr;
    QLabel* m_ratio = nullptr;
    QLabel* m_close = nullptr;
    QLabel* m_desc = nullptr;
    QPointer<AdjDate> m_dateWindow;
};

// The five entry windows by name.
class AdjustB : public AdjustEntry {
    Q_OBJECT
public:
    AdjustB(app::Session& s, app::AdjustmentInputs& in, QWidget* parent)
        : AdjustEntry(s, in, adjust::AdjType::Bonus, parent) {}
};
class AdjustC : public AdjustEntry {
    Q_OBJECT
public:
    AdjustC(app::Session& s, app::AdjustmentInputs& in, QWidget* parent)
        : AdjustEntry(s, in, adjust::AdjType::Cash, parent) {}
};
class AdjustSS : public AdjustEntry {
    Q_OBJECT
public:
    AdjustSS(app::Session& s, app::AdjustmentInputs& in, QWidget* parent)
        : AdjustEntry(s, in, adjust::AdjType::Split, parent) {}
};
class AdjustCC : public AdjustEntry {
    Q_OBJECT
public:
    AdjustCC(app::Session& s, app::AdjustmentInputs& in, QWidget* parent)
        : AdjustEntry(s, in, adjust::AdjType::Call, parent) {}
};
class AdjustD : public AdjustEntry {
    Q_OBJECT
public:
    AdjustD(app::Session& s, app::AdjustmentInputs& in, QWidget* parent)
        : AdjustEntry(s, in, adjust::AdjType::Dividend, parent) {}
};

class AdjustR : public QDialog {
    Q_OBJECT
public:
    AdjustR(app::Session& session, std::string code, QWidget* parent);
    QPushButton* proceedButton() const { return m_proceed; }

private:
    app::Session& m_session;
    std::string m_code;
    QPushButton* m_proceed;
};

class Adjust : public QDialog {
    Q_OBJECT
public:
    Adjust(app::Session& session, QWidget* parent);

    app::AdjustSelection& model() { return m_model; }
    QLineEdit* codeField() const { return m_code; }
    QLabel* nameLabel() const { return m_name; }
    QToolButton* upButton() const { return m_up; }
    QToolButton* downButton() const { return m_down; }
    // The open entry or removal window, if any.
    QDialog* openWindow() const { return m_open; }

    // Opening one window closes the one open before.
    AdjustEntry* OpenEntry(adjust::AdjType type);
    AdjustR* OpenRemove();

private:
    void ShowSecurity();
    void CloseOpen();

    app::AdjustSelection m_model;
    QLineEdit* m_code;
    QLabel* m_name;
    QToolButton* m_up;
    QToolButton* m_down;
    QPointer<QDialog> m_open;
};

// "Adjust Data for &Issues" > "&Manual Adjustment".
void RegisterAdjustWindows(MainWindow& main);

} // namespace kori::gui
