#pragma once
// Swing charts: a zig-zag of legs drawn with the bars, over them or in a side panel, by one of
// four methods: "NORM" (plain high-low swing with outside bars), "XDay" (N bars against the
// swing), "XPoint" (a fall or rise of V cents or points) and "XPointAuto" (V from the mean
// swing of the chart).
#include "chart/draw_context.h"
#include "chart/swing_method.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kori::chart {

namespace pal {
inline constexpr int SwingUp = 20, SwingDown = 21, SwingTitle = 27;
}

// Turning swing lines on forces bars at a spacing of at least 3; turning them off gives back
// the spacing that was in force before.
class SwingSwitch {
public:
    void Set(ChartRequest& r, bool on);

private:
    std::int16_t m_savedSpacing = 0;
};

// Mean height of the completed legs of a plain high-low swing, in cents for shares (type 4)
// and points for type 5; 5 for other types or when no leg completes.
float AverageSwing(const std::vector<store::ChartBar>& bars, std::int16_t recordType);

// Title line of the swing chart.
std::string SwingTitleText(char chartPeriod, SwingMethod method, float value);

// One bar as the swing routines see it: y of high, low and close, and the prices.
struct SwingBar {
    std::int16_t HighY = 0, LowY = 0, CloseY = 0;
    float High = 0, Low = 0, Close = 0;
};

// The swing state over a chart, fed bar by bar after each bar is drawn.
class SwingChart {
public:
    explicit SwingChart(ChartPainter& p);
    void Bar(int index, double barX, const SwingBar& bar);

    int Direction() const { return m_dir; }
    int Legs() const { return m_legs; }

private:
    void Start(const SwingBar& b);
    void Norm(const SwingBar& b);
    void XDay(const SwingBar& b);
    void XPoint(const SwingBar& b);
    void Follow(const SwingBar& b);
    void Carry(std::int16_t y);
    void Turn(int dir, std::int16_t y);
    void Title();

    ChartPainter& m_p;
    SwingMethod m_method = SwingMethod::Norm;
    float m_value = 0;
    bool m_panel = false;
    bool m_drawing = false;
    int m_seen = 0;
    double m_barX = 0;

    // SwingState
    int m_dir = 0; // 0 start, 1 up, 2 down; 4 and 5 after an outside bar (NORM)
    std::int16_t m_highY = 0, m_lowY = 0, m_closeY = 0; // the last swing bar
    double m_swingX = 0;
    std::int16_t m_turnY = 0; // where the current leg began
    std::int16_t m_legY = 0;  // how far it has gone
    std::int16_t m_drawnY = 0;
    bool m_legDrawn = false;
    int m_days = 0;
    float m_lastPrice = 0;
    int m_legs = 0;
};

} // namespace kori::chart
