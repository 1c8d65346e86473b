#include "app/window_position.h"
#include "support/temp_root.h"

#include <gtest/gtest.h>

using namespace kori::app;
using kori::test::TempRoot;

namespace {
// 1280 x 960 and 1920 x 1080 pixels, in twips.
constexpr ScreenSize kOld{19200, 14400};
constexpr ScreenSize kWide{28800, 16200};
} // namespace

TEST(WindowPosition, ScaledByTheScreenItWasWrittenOn) {
    const WindowPosition p{1500, 900, 9000, 6000};
    // Across by 1.5, down by 1.125; 900 x 1.125 = 1012.5 rounds to the even 1012.
    EXPECT_EQ(ScaleWindowPosition(p, kOld, kWide), (WindowPosition{2250, 1012, 13500, 6750}));
    EXPECT_EQ(ScaleWindowPosition({2250, 1012, 13500, 6750}, kWide, kOld),
              (WindowPosition{1500, 900, 9000, 6000}));
    // A place off to the left stays off to the left, in proportion.
    EXPECT_EQ(ScaleWindowPosition({-300, 0, 300, 300}, kOld, kWide).left, -450);
    EXPECT_EQ(ScaleWindowPosition(p, kOld, kOld), p);
    EXPECT_EQ(ScaleWindowPosition(p, {}, kWide), p) << "screen of unknown size";
    EXPECT_EQ(ScaleWindowPosition(p, kOld, {0, 16200}), p);
}

TEST(WindowPosition, ScreenIsKeptBesideTheFourNumbers) {
    TempRoot root;
    kori::platform::SettingsStore store(root.path() / "settings.ini");
    SaveWindowPosition(store, "ChtFonts", {1500, 900, 9000, 6000}, kOld);
    EXPECT_EQ(store.Get("ChtFonts", ""), "1500,900,9000,6000");
    EXPECT_EQ(store.Get("ChtFontsSW", ""), "19200");
    EXPECT_EQ(store.Get("ChtFontsSH", ""), "14400");
    EXPECT_EQ(StoredScreen(store, "ChtFonts"), kOld);

    EXPECT_EQ(LoadWindowPosition(store, "ChtFonts", kWide),
              (WindowPosition{2250, 1012, 13500, 6750}));
    EXPECT_EQ(LoadWindowPosition(store, "ChtFonts", kOld), (WindowPosition{1500, 900, 9000, 6000}));
    EXPECT_FALSE(LoadWindowPosition(store, "Scales", kWide)) << "absent: the design position";

    // A position kept before screens were kept, or beside a screen that reads as nonsense,
    // opens as it stands.
    store.Save("PLW", "300,150,4500,3000");
    EXPECT_EQ(LoadWindowPosition(store, "PLW", kWide), (WindowPosition{300, 150, 4500, 3000}));
    store.Save("PLWSW", "0");
    store.Save("PLWSH", "14400");
    EXPECT_FALSE(StoredScreen(store, "PLW"));
    EXPECT_EQ(LoadWindowPosition(store, "PLW", kWide), (WindowPosition{300, 150, 4500, 3000}));
}

TEST(WindowPosition, MainWindowSizeFromHeightAndWidth) {
    TempRoot root;
    kori::platform::SettingsStore store(root.path() / "settings.ini");
    MainWindowPlace fresh = LoadMainWindowPlace(store, kWide);
    EXPECT_EQ(fresh.width, 9045);
    EXPECT_EQ(fresh.height, 6645);
    EXPECT_FALSE(fresh.left);
    EXPECT_FALSE(fresh.top);
    EXPECT_FALSE(fresh.sizeStored) << "a first start";

    SaveMainWindowPlace(store, {600, 300, 12000, 9000}, kOld);
    EXPECT_EQ(store.Get("Width", ""), "12000");
    EXPECT_EQ(store.Get("Height", ""), "9000");
    EXPECT_EQ(store.Get("Main", ""), "600,300,12000,9000");
    EXPECT_EQ(store.Get("MainSW", ""), "19200");

    const MainWindowPlace same = LoadMainWindowPlace(store, kOld);
    EXPECT_EQ(same.width, 12000);
    EXPECT_EQ(same.height, 9000);
    EXPECT_EQ(same.left, 600);
    EXPECT_EQ(same.top, 300);
    EXPECT_TRUE(same.sizeStored);
    // On a screen half as big each way everything halves.
    const MainWindowPlace half = LoadMainWindowPlace(store, {9600, 7200});
    EXPECT_EQ(half.width, 6000);
    EXPECT_EQ(half.height, 4500);
    EXPECT_EQ(half.left, 300);
    EXPECT_EQ(half.top, 150);

    // The size keys rule the size; one that is not a positive number gives the design size,
    // which no screen scales.
    store.Save("Height", "abc");
    store.Save("Width", "-5");
    const MainWindowPlace bad = LoadMainWindowPlace(store, {9600, 7200});
    EXPECT_EQ(bad.height, 6645);
    EXPECT_EQ(bad.width, 9045);
}

TEST(MainWindowSize, FirstStartIsLargeEnoughYetWithinTheScreen) {
    using kori::app::FirstStartSize;
    using kori::app::PixelSize;
    // The design size (9045 x 6645 twips) is 603 x 443 pixels: far too small for the selection.
    const PixelSize design{603, 443};
    auto s = FirstStartSize(design, {1920, 1040});
    EXPECT_EQ(s.width, kori::app::kFirstStartSize.width);
    EXPECT_EQ(s.height, kori::app::kFirstStartSize.height);
    s = FirstStartSize(design, {1008, 728}); // a small screen: all of it
    EXPECT_EQ(s.width, 1008);
    EXPECT_EQ(s.height, 728);
    s = FirstStartSize({1400, 900}, {1920, 1040}); // a larger design size stands
    EXPECT_EQ(s.width, 1400);
    EXPECT_EQ(s.height, 900);
    s = FirstStartSize(design, {}); // no screen known
    EXPECT_EQ(s.width, kori::app::kFirstStartSize.width);
}

TEST(MainWindowSize, GrowsByWhatAChildLacksWithinTheScreen) {
    using kori::app::GrowToFit;
    // Window 800 x 600 with a work area of 780 x 500; the child reaches 900 x 450.
    auto s = GrowToFit({800, 600}, {780, 500}, {900, 450}, {1900, 1000});
    EXPECT_EQ(s.width, 920);
    EXPECT_EQ(s.height, 600);
    s = GrowToFit({800, 600}, {780, 500}, {2500, 700}, {1900, 1000}); // held by the screen
    EXPECT_EQ(s.width, 1900);
    EXPECT_EQ(s.height, 800);
    s = GrowToFit({800, 600}, {780, 500}, {700, 400}, {1900, 1000}); // fits: unchanged
    EXPECT_EQ(s.width, 800);
    EXPECT_EQ(s.height, 600);
}
