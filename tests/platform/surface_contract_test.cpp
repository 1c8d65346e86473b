// The drawing contract over the targets without Qt: the recorders, the band of a surface and
// the SVG document.
#include "platform/printer.h"
#include "platform/sub_surface.h"
#include "platform/surface.h"
#include "platform/svg_surface.h"
#include "support/surface_contract.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <string>
#include <vector>

namespace kori::test {
namespace {

std::string Hash(platform::Colour c) {
    return " #" + std::to_string(c);
}

// A recorder shows a mark when it recorded the call, `dy` lower when it sits under a band.
bool Recorded(const std::vector<std::string>& calls, const Drawn& d, int dy = 0) {
    auto four = [&](const char* name) {
        return std::string(name) + " " + std::to_string(d.x1) + "," + std::to_string(d.y1 + dy) +
               "," + std::to_string(d.x2) + "," + std::to_string(d.y2 + dy) + Hash(d.colour);
    };
    std::string want;
    switch (d.mark) {
    case Mark::Clear:
        want = "Clear" + Hash(d.colour);
        break;
    case Mark::Line:
        want = four("Line");
        break;
    case Mark::Box:
        want = four("Box");
        break;
    case Mark::FilledBox:
        want = four("FilledBox");
        break;
    case Mark::Point:
        want = "Point " + std::to_string(d.x1) + "," + std::to_string(d.y1 + dy) + Hash(d.colour);
        break;
    case Mark::Text: {
        const std::string at = "Text " + std::to_string(d.x1) + "," + std::to_string(d.y1 + dy);
        return std::any_of(calls.begin(), calls.end(), [&](const std::string& c) {
            return c.starts_with(at + " ") && c.find(Hash(d.colour) + " [") != std::string::npos;
        });
    }
    }
    return std::find(calls.begin(), calls.end(), want) != calls.end();
}

FontState FontOf(const platform::RecordingSurface& s) {
    return {s.fontName(), s.fontSize(), s.bold(), s.italic()};
}

} // namespace

template <> struct ContractSubject<platform::RecordingSurface> {
    platform::RecordingSurface target{200, 120};
    platform::Surface& surface() { return target; }
    static std::optional<std::pair<double, double>> MadeSize() { return {{200, 120}}; }
    static constexpr bool kClearErases = false; // a log keeps what came before
    bool Shows(const Drawn& d) { return Recorded(target.calls(), d); }
    FontState Font() { return FontOf(target); }
};

template <> struct ContractSubject<platform::RecordingPrinter> {
    platform::RecordingPrinter target;
    platform::Printer& surface() { return target; }
    static std::optional<std::pair<double, double>> MadeSize() { return {{4961, 7016}}; }
    static constexpr bool kClearErases = false;
    bool Shows(const Drawn& d) { return Recorded(target.calls(), d); }
    FontState Font() { return FontOf(target.page()); }
    int Pages() {
        const auto& c = target.calls();
        return 1 + static_cast<int>(std::count(c.begin(), c.end(), "NewPage"));
    }
    bool Whole() {
        const auto& c = target.calls();
        return !c.empty() && c.back() == "EndDoc" && std::count(c.begin(), c.end(), "EndDoc") == 1;
    }
};

// A band 120 high, 100 down a taller recorder: what it draws lands 100 lower on the whole.
template <> struct ContractSubject<platform::SubSurface> {
    platform::RecordingSurface whole{200, 300};
    platform::SubSurface target{whole, 100, 120};
    platform::Surface& surface() { return target; }
    static std::optional<std::pair<double, double>> MadeSize() { return {{200, 120}}; }
    static constexpr bool kClearErases = false;
    bool Shows(const Drawn& d) {
        if (d.mark == Mark::Clear) // only the band is cleared
            return Recorded(whole.calls(), {Mark::FilledBox, 0, 100, 200, 220, d.colour});
        return Recorded(whole.calls(), d, 100);
    }
    FontState Font() { return FontOf(whole); }
};

template <> struct ContractSubject<platform::SvgSurface> {
    platform::SvgSurface target{200, 120};
    platform::Surface& surface() { return target; }
    static std::optional<std::pair<double, double>> MadeSize() { return {{200, 120}}; }
    static constexpr bool kClearErases = true;
    // An element of the document of the right kind, at the right place, in the right colour.
    bool Shows(const Drawn& d) {
        char hex[8];
        std::snprintf(hex, sizeof hex, "#%02x%02x%02x", platform::Red(d.colour),
                      platform::Green(d.colour), platform::Blue(d.colour));
        const std::string colour = hex;
        auto at = [](const char* x, int vx, const char* y, int vy) {
            return std::string(x) + "=\"" + std::to_string(vx) + "\" " + y + "=\"" +
                   std::to_string(vy) + "\"";
        };
        std::string head, colourAttr;
        switch (d.mark) {
        case Mark::Clear:
            head = "<rect " + at("x", 0, "y", 0) + " width=\"200\" height=\"120\"";
            colourAttr = "fill=\"" + colour + "\"";
            break;
        case Mark::Line:
            head = "<line " + at("x1", d.x1, "y1", d.y1) + " " + at("x2", d.x2, "y2", d.y2);
            colourAttr = "stroke=\"" + colour + "\"";
            break;
        case Mark::Box:
            head = "<rect " + at("x", d.x1, "y", d.y1);
            colourAttr = "fill=\"none\" stroke=\"" + colour + "\"";
            break;
        case Mark::FilledBox:
        case Mark::Point:
            head = "<rect " + at("x", d.x1, "y", d.y1);
            colourAttr = "fill=\"" + colour + "\"";
            break;
        case Mark::Text:
            head = "<text x=\"" + std::to_string(d.x1) + "\"";
            colourAttr = "fill=\"" + colour + "\"";
            break;
        }
        const std::string doc = target.Document();
        for (std::size_t from = 0, end; (from = doc.find(head, from)) != std::string::npos;
             from = end) {
            end = doc.find('\n', from);
            if (doc.substr(from, end - from).find(colourAttr) != std::string::npos) return true;
        }
        return false;
    }
    // The document keeps the font with each text: print one and read it back from there.
    FontState Font() {
        target.PrintText("f");
        const std::string doc = target.Document();
        const std::string text = doc.substr(doc.rfind("<text "));
        auto attr = [&](const std::string& name) {
            const auto from = text.find(" " + name + "=\"");
            if (from == std::string::npos) return std::string();
            const auto start = from + name.size() + 3;
            return text.substr(start, text.find('"', start) - start);
        };
        const double points = std::stod(attr("font-size")) * 72 / 96;
        return {attr("font-family"), std::round(points * 1000) / 1000,
                attr("font-weight") == "bold", attr("font-style") == "italic"};
    }
};

using CoreSurfaces = testing::Types<platform::RecordingSurface, platform::RecordingPrinter,
                                    platform::SubSurface, platform::SvgSurface>;
INSTANTIATE_TYPED_TEST_SUITE_P(Core, SurfaceContract, CoreSurfaces);
INSTANTIATE_TYPED_TEST_SUITE_P(Core, PrinterContract, platform::RecordingPrinter);

} // namespace kori::test
