#pragma once
// Volume to y on the volume panel: arithmetic against a cap of the mean volume times the
// volume multiple, or logarithmic between the smallest and largest volume.
#include <cstdint>
#include <optional>

namespace kori::chart {

struct VolumeScaleInputs {
    bool Logarithmic = false;
    bool LimitHeight = false; // bars stop at VolTop instead of reaching into the prices
    std::int16_t VolTop = 0, VolBottom = 0, PlotTop = 0;
    std::int32_t MinVolume = 0, MaxVolume = 0, AvgVolume = 0;
    std::int16_t VolumeMultiple = 1;
};

class VolumeMap {
public:
    // False when the panel has no height or the volumes no spread: no volume bars then.
    bool Prepare(const VolumeScaleInputs& in);
    // y of the top of a volume bar; none for a volume of 0 or an unusable scale.
    std::optional<std::int16_t> VolumeToY(std::int32_t volume) const;
    // Volume at a y of the panel, for the labels.
    double YToVolume(double y) const;

    bool ready() const { return m_ready; }
    float UnitsPerVolume() const { return m_unitsPerVolume; }

private:
    VolumeScaleInputs m_in;
    bool m_ready = false;
    float m_unitsPerVolume = 0;
    double m_logMin = 0, m_logFactor = 0;
};

} // namespace kori::chart
