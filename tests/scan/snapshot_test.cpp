#include "scan/snapshot.h"

#include "osc/osc_compute.h"
#include "scan_rig.h"
#include "store/load_chart_series.h"
#include "store/store_builders.h"

#include <gtest/gtest.h>

#include <chrono>

using namespace kori;
using namespace kori::scan;
using kori::test::RigSecurity;
using kori::test::TempRoot;

namespace {

// A record a weekday from 2 January 2024 on: enough dates for more than a year of bars.
std::string Weekday(int n) {
    using namespace std::chrono;
    sys_days day = sys_days{2024y / January / 2};
    for (int i = 0; i < n;) {
        day += days{1};
        const weekday w{day};
        if (w != Saturday && w != Sunday) ++i;
    }
    const year_month_day ymd{day};
    char text[16];
    std::snprintf(text, sizeof text, "%04d%02d%02d", static_cast<int>(ymd.year()),
                  static_cast<unsigned>(ymd.month()), static_cast<unsigned>(ymd.day()));
    return text;
}

// Closes 10, 11, ... 39 with highs a dollar above and lows a dollar below, volume 100 a day
// and 250 on the last.
std::string Rising(int count = 30) {
    std::vector<store::PriceRecord> records;
    for (int i = 0; i < count; ++i) {
        const float c = static_cast<float>(10 + i);
        const std::string date = Weekday(i);
        records.push_back(test::Day(date.c_str(), c, c + 1, c - 1, c, i == count - 1 ? 250 : 100));
    }
    return test::Bytes(records);
}

// The oscillators at their defaults, as a library without settings reads them.
SnapshotSettings Settings(bool exponential = false) {
    SnapshotSettings s;
    s = SnapshotSettingsFrom(platform::IniFile("/nonexistent/Kori.ini"));
    s.Average1 = 10;
    s.Average2 = 30;
    s.Exponential = exponential;
    return s;
}

} // namespace

TEST(Snapshot, LastDayFiguresWorkedByHand) {
    const auto row = SnapshotOf(test::Name("UP", "Rising Ltd"), Rising(), 1, Settings());
    ASSERT_TRUE(row);
    EXPECT_EQ(row->Code, "UP");
    EXPECT_EQ(row->Date, Weekday(29));
    EXPECT_DOUBLE_EQ(row->Close, 39);
    EXPECT_DOUBLE_EQ(*row->Change, 1);
    EXPECT_NEAR(*row->ChangePercent, 100.0 / 38, 1e-9);
    EXPECT_DOUBLE_EQ(*row->VolumeRatio, 2.5); // 250 against the 100 of the 20 days before
    EXPECT_NEAR(*row->AboveAverage1, (39 - 34.5) / 34.5 * 100, 1e-9); // mean of 30..39
    EXPECT_NEAR(*row->AboveAverage2, (39 - 24.5) / 24.5 * 100, 1e-9); // mean of 10..39
    EXPECT_DOUBLE_EQ(row->YearHigh, 40);
    EXPECT_DOUBLE_EQ(row->YearLow, 9);
    EXPECT_TRUE(row->NewHigh);
    EXPECT_FALSE(row->NewLow);
    EXPECT_FALSE(row->Rsi); // no fall in the window: the line has no figure yet

    // On a straight rise the exponential average seeded with the first ten closes stands the
    // same 4.5 behind the close as the simple one.
    const auto ema = SnapshotOf(test::Name("UP", "Rising Ltd"), Rising(), 1, Settings(true));
    EXPECT_NEAR(*ema->AboveAverage1, (39 - 34.5) / 34.5 * 100, 1e-9);
}

TEST(Snapshot, OscillatorsAreTheChartsOwnOnTheSameBars) {
    const std::string bytes = Rising(60);
    SnapshotSettings settings = Settings();
    const auto row = SnapshotOf(test::Name("UP", "Rising Ltd"), bytes, 1, settings);
    ASSERT_TRUE(row);
    store::SeriesRequest request;
    request.LastRecord = 60;
    store::ChartSeries series;
    ASSERT_TRUE(store::LoadChartSeriesFromBytes(bytes, request, "UP", series));
    const auto sto = osc::ComputeOscillator("STO", series, settings.Oscillators, {});
    ASSERT_TRUE(sto && row->StochasticK);
    EXPECT_DOUBLE_EQ(*row->StochasticK, *sto->Row(sto->RowCount() - 1)[0]);
    const auto macd = osc::ComputeOscillator("MACD", series, settings.Oscillators, {});
    ASSERT_TRUE(macd);
    const auto last = macd->Row(macd->RowCount() - 1);
    ASSERT_EQ(macd->columns, (std::vector<std::string>{"ema1", "ema2", "macd", "signal"}));
    ASSERT_TRUE(row->MacdAboveSignal && last[2] && last[3]);
    EXPECT_EQ(*row->MacdAboveSignal, *last[2] > *last[3]);
}

TEST(Snapshot, TheYearIsTheLast260BarsAndItsExtremesAreNewOnlyWhenPassed) {
    // 300 bars: a spike to 500 in bar 10 falls out of the year; a dip to 1 in bar 100 stays.
    std::vector<store::PriceRecord> records;
    for (int i = 0; i < 300; ++i) {
        const float c = i == 10 ? 500.f : (i == 100 ? 1.f : 50.f);
        const std::string date = Weekday(i);
        records.push_back(test::Day(date.c_str(), c, c, c, c, 100));
    }
    const auto row =
        SnapshotOf(test::Name("FLAT", "Flat Ltd"), test::Bytes(records), 1, Settings());
    ASSERT_TRUE(row);
    EXPECT_DOUBLE_EQ(row->YearHigh, 50);
    EXPECT_DOUBLE_EQ(row->YearLow, 1);
    EXPECT_FALSE(row->NewHigh); // equal to the year's high is not a new one
    EXPECT_FALSE(row->NewLow);
    EXPECT_DOUBLE_EQ(*row->Change, 0);
}

TEST(Snapshot, MarketBreadthAndAFileThatCannotGiveARow) {
    TempRoot root;
    std::vector<float> up, down;
    for (int i = 0; i < 30; ++i) {
        up.push_back(static_cast<float>(10 + i));
        down.push_back(static_cast<float>(60 - i));
    }
    test::WriteRig(root, {RigSecurity{"UP", up}, RigSecurity{"DOWN", down},
                          RigSecurity{"FLAT", std::vector<float>(30, 5.f)},
                          RigSecurity{"ONE", {7.f}}, RigSecurity{"GONE", {}}});
    platform::NullProgress progress;
    const auto result = TakeSnapshot({root.folder(), 0}, Settings(), progress);
    ASSERT_TRUE(result.Status.ok());
    ASSERT_EQ(result.Rows.size(), 4u); // GONE has no price file
    EXPECT_EQ(result.Rows[0].Code, "UP");
    EXPECT_EQ(result.Rows[3].Code, "ONE");
    EXPECT_FALSE(result.Rows[3].Change);
    EXPECT_EQ(result.Market.Advances, 1);
    EXPECT_EQ(result.Market.Declines, 1);
    EXPECT_EQ(result.Market.Unchanged, 1);
    EXPECT_EQ(result.Market.NewHighs, 1);
    EXPECT_EQ(result.Market.NewLows, 1);
    const std::string csv = SnapshotCsv(result);
    EXPECT_EQ(csv.substr(0, csv.find('\n')),
              "Code,Name,Date,Close,Change,Change %,Volume/Average,RSI,%K,MACD,Close/Average 1 "
              "%,Close/Average 2 %,52-Week High,52-Week Low");
    EXPECT_EQ(std::count(csv.begin(), csv.end(), '\n'), 5);
}
