#include "gui/widgets/window_place.h"

#include "app/window_position.h"

#include <QEvent>
#include <QScreen>
#include <QWidget>

namespace kori::gui {

namespace {
class PositionKeeper : public QObject {
public:
    PositionKeeper(QWidget* window, platform::SettingsStore& store, std::string key)
        : QObject(window), m_window(window), m_store(store), m_key(std::move(key)) {
        window->installEventFilter(this);
    }

protected:
    bool eventFilter(QObject* watched, QEvent* e) override {
        if (watched != m_window) return false;
        if (e->type() == QEvent::Show && !m_placed) {
            m_placed = true;
            if (const auto p = app::LoadWindowPosition(m_store, m_key, ScreenTwips(m_window))) {
                // The same client geometry that closing wrote.
                const QSize size = p->width > 0 && p->height > 0 ? QSize(p->width / kTwipsPerPixel,
                                                                         p->height / kTwipsPerPixel)
                                                                 : m_window->size();
                const QRect stored(p->left / kTwipsPerPixel, p->top / kTwipsPerPixel, size.width(),
                                   size.height());
                // A place on a screen that is no longer there keeps the design position.
                const QScreen* screen = m_window->screen();
                if (!screen || screen->availableVirtualGeometry().intersects(stored))
                    m_window->setGeometry(stored);
            }
        } else if (e->type() == QEvent::Close || e->type() == QEvent::Hide) {
            if (m_placed) Save();
        }
        return false;
    }

private:
    void Save() {
        const QRect g = m_window->geometry();
        app::SaveWindowPosition(m_store, m_key,
                                {g.x() * kTwipsPerPixel, g.y() * kTwipsPerPixel,
                                 g.width() * kTwipsPerPixel, g.height() * kTwipsPerPixel},
                                ScreenTwips(m_window));
    }

    QWidget* m_window;
    platform::SettingsStore& m_store;
    std::string m_key;
    bool m_placed = false;
};
} // namespace

app::ScreenSize ScreenTwips(const QWidget* window) {
    const QScreen* screen = window->screen();
    if (!screen) return {};
    const QSize s = screen->geometry().size();
    return {s.width() * kTwipsPerPixel, s.height() * kTwipsPerPixel};
}

void KeepWindowPosition(QWidget* window, platform::SettingsStore& store, const std::string& key) {
    new PositionKeeper(window, store, key);
}

} // namespace kori::gui
