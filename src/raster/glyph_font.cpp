#include "raster/glyph_font.h"

#include <fontconfig/fontconfig.h>
#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_OUTLINE_H

#include <array>
#include <cctype>
#include <filesystem>
#include <map>
#include <mutex>
#include <tuple>

namespace kori::raster {

namespace {

constexpr int kPhases = 4; // pen positions a pixel is split into

FT_Library Library() {
    static FT_Library library = [] {
        FT_Library l = nullptr;
        if (FT_Init_FreeType(&l) != 0) return static_cast<FT_Library>(nullptr);
        return l;
    }();
    return library;
}

// The file the font configuration gives for a family and face, as the desktop would pick it.
std::string FindFontFile(const std::string& family, bool bold, bool italic) {
    static std::mutex lock;
    static std::map<std::tuple<std::string, bool, bool>, std::string> found;
    const std::lock_guard<std::mutex> hold(lock);
    const auto key = std::make_tuple(family, bold, italic);
    if (auto it = found.find(key); it != found.end()) return it->second;
    std::string file;
    // The charts' own font: where only its metric twin is installed, the font configuration
    // would answer with it, and asking costs a tenth of a picture's time in parsing its files.
    static const char* const kFaces[] = {"Regular", "Italic", "Bold", "BoldItalic"};
    const std::string twin = std::string("/usr/share/fonts/truetype/liberation/LiberationSans-") +
                             kFaces[(bold ? 2 : 0) + (italic ? 1 : 0)] + ".ttf";
    std::string lower = family;
    for (char& c : lower)
        c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
    if (lower == "arial" && !std::filesystem::exists("/usr/share/fonts/truetype/msttcorefonts") &&
        std::filesystem::exists(twin))
        file = twin;
    if (file.empty() && FcInit()) {
        FcPattern* pattern = FcPatternCreate();
        FcPatternAddString(pattern, FC_FAMILY, reinterpret_cast<const FcChar8*>(family.c_str()));
        FcPatternAddString(pattern, FC_FAMILY, reinterpret_cast<const FcChar8*>("sans-serif"));
        FcPatternAddInteger(pattern, FC_WEIGHT, bold ? FC_WEIGHT_BOLD : FC_WEIGHT_REGULAR);
        FcPatternAddInteger(pattern, FC_SLANT, italic ? FC_SLANT_ITALIC : FC_SLANT_ROMAN);
        FcConfigSubstitute(nullptr, pattern, FcMatchPattern);
        FcDefaultSubstitute(pattern);
        FcResult result = FcResultNoMatch;
        if (FcPattern* match = FcFontMatch(nullptr, pattern, &result)) {
            FcChar8* path = nullptr;
            if (FcPatternGetString(match, FC_FILE, 0, &path) == FcResultMatch && path != nullptr)
                file = reinterpret_cast<const char*>(path);
            FcPatternDestroy(match);
        }
        FcPatternDestroy(pattern);
    }
    // No font configuration: the metric twin of Arial where Debian installs it.
    if (file.empty()) file = twin;
    found.emplace(key, file);
    return file;
}

} // namespace

struct GlyphFont::Impl {
    FT_Face face = nullptr;
    std::map<int, Glyph> glyphs; // key: byte * kPhases + phase
    ~Impl() {
        if (face != nullptr) FT_Done_Face(face);
    }
};

GlyphFont::GlyphFont(std::unique_ptr<Impl> impl) : m_impl(std::move(impl)) {
    const FT_Face face = m_impl->face;
    m_ascent = static_cast<int>(FT_MulFix(face->ascender, face->size->metrics.y_scale));
    m_descent = static_cast<int>(FT_MulFix(-face->descender, face->size->metrics.y_scale));
}

GlyphFont::~GlyphFont() = default;

std::shared_ptr<GlyphFont> GlyphFont::Open(const std::string& family, bool bold, bool italic,
                                           int pixelSize) {
    FT_Library library = Library();
    if (library == nullptr) return nullptr;
    auto impl = std::make_unique<Impl>();
    const std::string file = FindFontFile(family, bold, italic);
    if (FT_New_Face(library, file.c_str(), 0, &impl->face) != 0) {
        impl->face = nullptr;
        return nullptr;
    }
    if (FT_Set_Char_Size(impl->face, 0, static_cast<FT_F26Dot6>(pixelSize) * 64, 72, 72) != 0)
        return nullptr;
    return std::shared_ptr<GlyphFont>(new GlyphFont(std::move(impl)));
}

// Light hinting (vertical only) and grey coverage, as the desktop renders small chart text.
const Glyph& GlyphFont::Get(unsigned char ch, int phase) {
    const int key = ch * kPhases + phase;
    if (auto it = m_impl->glyphs.find(key); it != m_impl->glyphs.end()) return it->second;
    Glyph& g = m_impl->glyphs[key];
    const FT_Face face = m_impl->face;
    // Stream text is Latin-1, whose code points are the bytes themselves.
    const FT_UInt index = FT_Get_Char_Index(face, ch);
    if (FT_Load_Glyph(face, index, FT_LOAD_DEFAULT | FT_LOAD_TARGET_LIGHT) != 0) return g;
    g.advance = static_cast<int>(face->glyph->linearHoriAdvance >> 10);
    if (face->glyph->format == FT_GLYPH_FORMAT_OUTLINE && phase != 0)
        FT_Outline_Translate(&face->glyph->outline, phase * 64 / kPhases, 0);
    if (FT_Render_Glyph(face->glyph, FT_RENDER_MODE_NORMAL) != 0) return g;
    const FT_Bitmap& bitmap = face->glyph->bitmap;
    g.left = face->glyph->bitmap_left;
    g.top = face->glyph->bitmap_top;
    g.width = static_cast<int>(bitmap.width);
    g.rows = static_cast<int>(bitmap.rows);
    g.coverage.resize(static_cast<std::size_t>(g.width) * static_cast<std::size_t>(g.rows));
    for (int y = 0; y < g.rows; ++y)
        for (int x = 0; x < g.width; ++x)
            g.coverage[static_cast<std::size_t>(y * g.width + x)] =
                bitmap.buffer[static_cast<std::ptrdiff_t>(y) * bitmap.pitch + x];
    return g;
}

int GlyphFont::Kerning(unsigned char left, unsigned char right) {
    const FT_Face face = m_impl->face;
    if (!FT_HAS_KERNING(face)) return 0;
    FT_Vector kern{0, 0};
    if (FT_Get_Kerning(face, FT_Get_Char_Index(face, left), FT_Get_Char_Index(face, right),
                       FT_KERNING_UNFITTED, &kern) != 0)
        return 0;
    return static_cast<int>(kern.x);
}

} // namespace kori::raster
