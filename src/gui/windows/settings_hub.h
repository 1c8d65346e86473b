#pragma once
// What the settings windows tell the rest of the program. The chart window connects to
// RebuildChart; the main window to the folder and exit signals. One hub lives under the main
// window, so windows and tests find it without globals.
#include <QObject>
#include <QString>

namespace kori::gui {

class SettingsHub : public QObject {
    Q_OBJECT
public:
    explicit SettingsHub(QObject* parent = nullptr) : QObject(parent) {
        setObjectName(QStringLiteral("SettingsHub"));
    }

signals:
    // A small window stored a value the chart on show depends on: build it again.
    void RebuildChart();
    // "SAVE" in the chart defaults: defaults and oscillator settings were written and read
    // again; the chart on show is drawn again with them.
    void ChartDefaultsSaved();
    // OK in the oscillator settings: the oscillator is to be shown with its new settings.
    void ShowOscillator(const QString& oscName);
    // The data folder changed: the caption follows, chart selection goes to the full list.
    void DataFolderChanged();
    void ColoursChanged();
    void FontsChanged();
    // "MultiOsc Setup" stored the two sets: a multi-oscillator chart on show is drawn again.
    void MultiOscSaved();
    // Chart2: the second chart of a split, by code and period ('A', 'W', 'M').
    void SecondChart(const QString& code, QChar period);
    // "Select CANCEL to exit KORI" in the path details.
    void ExitRequested();
};

} // namespace kori::gui
