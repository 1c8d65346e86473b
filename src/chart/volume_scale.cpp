#include "chart/volume_scale.h"

#include "chart/scale.h"

#include <cmath>

namespace kori::chart {

bool VolumeMap::Prepare(const VolumeScaleInputs& in) {
    m_in = in;
    m_ready = false;
    if (in.Logarithmic) {
        const double spread = std::log(static_cast<double>(in.MaxVolume)) -
                              std::log(static_cast<double>(in.MinVolume));
        m_logMin = std::log(static_cast<double>(in.MinVolume));
        m_logFactor = static_cast<double>(in.VolTop - in.VolBottom) / spread;
        m_ready = std::isfinite(m_logFactor) && m_logFactor != 0 && std::isfinite(m_logMin);
        return m_ready;
    }
    double cap = static_cast<double>(in.AvgVolume) * in.VolumeMultiple;
    if (cap < 11) cap = 10;
    // The 1.03 goes on VolTop alone, which leaves the panel a little short.
    const float height =
        std::nearbyint(static_cast<float>(in.VolBottom) - static_cast<float>(in.VolTop) * 1.03f);
    const double top = cap > 0 ? cap : static_cast<double>(in.MaxVolume);
    m_unitsPerVolume = static_cast<float>(top - in.MinVolume) / height;
    m_ready = height > 0 && std::isfinite(m_unitsPerVolume) && m_unitsPerVolume > 0;
    return m_ready;
}

std::optional<std::int16_t> VolumeMap::VolumeToY(std::int32_t volume) const {
    if (!m_ready || volume == 0) return std::nullopt;
    std::int16_t y;
    if (m_in.Logarithmic) {
        const double v = std::floor(
            m_in.VolBottom + (std::log(static_cast<double>(volume)) - m_logMin) * m_logFactor);
        y = ToY16(v, m_in.VolBottom);
    } else {
        const float v = static_cast<float>(m_in.VolBottom) -
                        static_cast<float>(static_cast<std::int64_t>(volume) - m_in.MinVolume) /
                            m_unitsPerVolume;
        y = ToY16(std::nearbyint(static_cast<double>(v)), m_in.VolBottom);
        if (y < 0) y = m_in.PlotTop;
    }
    if (m_in.LimitHeight && y < m_in.VolTop) y = m_in.VolTop;
    return y;
}

double VolumeMap::YToVolume(double y) const {
    if (!m_ready) return 0;
    if (m_in.Logarithmic) return std::exp(m_logMin + (y - m_in.VolBottom) / m_logFactor);
    return m_in.MinVolume + (m_in.VolBottom - y) * static_cast<double>(m_unitsPerVolume);
}

} // namespace kori::chart
