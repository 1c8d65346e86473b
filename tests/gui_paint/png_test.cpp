// The chart picture's PNG: the same pixels whichever way it is encoded, and back.
#include "gui/paint/qt_surface.h"

#include <QBuffer>
#include <QImage>

#include <gtest/gtest.h>

namespace kori::gui {
namespace {

QImage ChartLikePicture() {
    ImageSurface area(640, 400);
    area.SetBackColour(platform::Rgb(0, 0, 0));
    area.Clear();
    for (int i = 0; i < 60; ++i)
        area.Line(10 + i * 10, 300 - i * 3, 10 + i * 10, 340 - (i % 7) * 5,
                  platform::Rgb(static_cast<std::uint8_t>(i * 4), 200, 255));
    area.Box(5, 5, 630, 390, platform::Rgb(128, 128, 128));
    area.FilledBox(100, 20, 180, 60, platform::Rgb(250, 250, 0));
    area.SetTextPosition(20, 20);
    area.PrintText("KORI Charting 12.345");
    return area.Finish().copy();
}

QImage Decoded(const QByteArray& png) {
    QImage back;
    EXPECT_TRUE(back.loadFromData(png, "PNG"));
    return back.convertToFormat(QImage::Format_RGB32);
}

TEST(PngPicture, KeepsEveryPixelAndTheResolution) {
    const QImage picture = ChartLikePicture();
    ASSERT_EQ(picture.format(), QImage::Format_RGB32);
    QByteArray png;
    ASSERT_TRUE(EncodePng(picture, png));
    const QImage back = Decoded(png);
    ASSERT_EQ(back.size(), picture.size());
    EXPECT_TRUE(back == picture);
    QImage withHeader;
    ASSERT_TRUE(withHeader.loadFromData(png, "PNG"));
    EXPECT_EQ(withHeader.dotsPerMeterX(), picture.dotsPerMeterX());
    EXPECT_FALSE(withHeader.hasAlphaChannel());

    // The general encoder gives the same picture.
    QByteArray general;
    QBuffer buffer(&general);
    buffer.open(QIODevice::WriteOnly);
    ASSERT_TRUE(picture.save(&buffer, "PNG"));
    EXPECT_TRUE(Decoded(general) == back);
}

// Pictures that do not compress (noise) and pictures of one row or one column still come back
// whole: the compressed data may be larger than the rows it holds.
TEST(PngPicture, IncompressibleAndThinPicturesComeBack) {
    for (const QSize size : {QSize(1, 1), QSize(333, 1), QSize(1, 257), QSize(301, 207)}) {
        QImage picture(size, QImage::Format_RGB32);
        std::uint32_t seed = 12345;
        for (int y = 0; y < size.height(); ++y)
            for (int x = 0; x < size.width(); ++x) {
                seed = seed * 1664525u + 1013904223u;
                picture.setPixel(x, y, qRgb(seed >> 24, (seed >> 16) & 0xFF, (seed >> 8) & 0xFF));
            }
        QByteArray png;
        ASSERT_TRUE(EncodePng(picture, png));
        EXPECT_TRUE(Decoded(png) == picture) << size.width() << "x" << size.height();
    }
}

TEST(PngPicture, PicturesWithTransparencyKeepIt) {
    QImage picture(50, 40, QImage::Format_ARGB32);
    picture.fill(qRgba(10, 20, 30, 0));
    picture.setPixel(3, 4, qRgba(200, 100, 50, 255));
    QByteArray png;
    ASSERT_TRUE(EncodePng(picture, png));
    QImage back;
    ASSERT_TRUE(back.loadFromData(png, "PNG"));
    EXPECT_TRUE(back.hasAlphaChannel());
    EXPECT_EQ(back.pixel(3, 4), qRgba(200, 100, 50, 255));
    EXPECT_EQ(qAlpha(back.pixel(0, 0)), 0);
}

} // namespace
} // namespace kori::gui
