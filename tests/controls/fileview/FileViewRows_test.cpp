#include "controls/fileview/FileViewRows.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <optional>
#include <random>
#include <string>
#include <vector>

#include "frame/Dates.h"
#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"

/// The texts that rows are made of, and the numbers that stand in for them in a sort.
namespace tessel::controls {
namespace {

using child::RowId;
using Details = FileViewRows::Details;

/// A place whose clocks are turned back by an hour at one moment, and forward at another.
class TurningClocks final : public frame::Locale {
  public:
    static constexpr std::int64_t back = 1'000'000'800, forward = 1'200'000'600;

    std::string DateText(frame::Date date) override { return frame::DateText(date); }
    std::string LongDateText(frame::Date date) override { return frame::DateText(date); }
    std::string Grouped(std::int64_t number) override { return frame::Decimal(number); }
    frame::Date LocalTime(std::int64_t seconds) override {
        constexpr std::int64_t hour = 3600;
        return fixed_.LocalTime(seconds + (seconds >= back && seconds < forward ? hour : 2 * hour));
    }

  private:
    headless::FixedLocale fixed_;
};

class FileViewRowsTest : public testing::Test {
  protected:
    frame::Services WithClocks() {
        frame::Services services = lender.LentServices();
        services.locale = &locale;
        return services;
    }
    headless::HeadlessHost lender;
    TurningClocks locale;
    frame::Host host{WithClocks()};
    FileViewRows rows{host};
};

TEST_F(FileViewRowsTest, SortNumbersOrderAsTheTextsDo) {
    std::mt19937_64 random(3);
    const auto pick = [&](std::vector<std::int64_t> from) {
        return from[random() % from.size()] + static_cast<std::int64_t>(random() % 5000);
    };
    const std::vector<std::int64_t> times = {TurningClocks::back - 3600,
                                             TurningClocks::back,
                                             TurningClocks::forward - 3600,
                                             TurningClocks::forward,
                                             -4000,
                                             0,
                                             -60'000'000'000,
                                             253'402'300'000 - 9000,
                                             300'000'000'000,
                                             -3'000'000'000,
                                             1'700'000'000,
                                             31'536'000'000};
    const std::vector<std::int64_t> sizes = {0, 999, 999'999'999'000, 999'999'994'000, 1'000'000'000'000};
    constexpr RowId count = 400;
    for (RowId row = 0; row < count; ++row) {
        frame::FileRecord record;
        record.size = pick(sizes);
        record.created = pick(times);
        record.modified = random() % 4 == 0 ? record.created : pick(times);
        if (random() % 3 == 0)
            rows.CaptureFolder(row, "f" + std::to_string(row), "C:\\gone", record,
                               random() % 2 == 0 ? Details::Shown : Details::Hidden);
        else
            rows.CaptureFile(row, "n" + std::to_string(row), "C:\\x", record);
    }
    for (const int column : {5, 7, 8, 9})
        for (RowId a = 0; a < count; ++a) {
            const std::string textOfA = rows.Text(a, column);
            const std::optional<std::uint64_t> numberOfA = rows.SortNumber(a, column);
            ASSERT_EQ(numberOfA == std::uint64_t{0}, textOfA.empty()) << column << " " << textOfA;
            for (RowId b = 0; b < count; b += 7) {
                const auto numberOfB = rows.SortNumber(b, column);
                if (!numberOfA || !numberOfB) continue;
                const int byTexts = frame::CompareNoCase(textOfA, rows.Text(b, column));
                ASSERT_EQ(*numberOfA < *numberOfB, byTexts < 0) << column << " " << textOfA << " " << rows.Text(b, column);
                ASSERT_EQ(*numberOfA == *numberOfB, byTexts == 0) << column << " " << textOfA << " " << rows.Text(b, column);
            }
        }
}

TEST_F(FileViewRowsTest, AnHourThatComesTwiceIsToldTwice) {
    rows.CaptureFile(0, "a", "C:\\x", {.modified = TurningClocks::back - 1});
    rows.CaptureFile(1, "b", "C:\\x", {.modified = TurningClocks::back + 3599});
    EXPECT_EQ(rows.Text(0, 8), rows.Text(1, 8));
    EXPECT_EQ(rows.SortNumber(0, 8), rows.SortNumber(1, 8));
}

TEST_F(FileViewRowsTest, ANumberThatIsUsedAgainShowsTheNewRow) {
    rows.CaptureFile(0, "long name.txt", "C:\\x", {.size = 1});
    rows.CaptureFile(1, "other", "C:\\y", {.size = 2});
    rows.CaptureFile(0, "short", "C:\\z", {.size = 3});
    EXPECT_EQ(rows.Text(0, 0), "short");
    EXPECT_EQ(rows.Text(0, 6), "C:\\z");
    EXPECT_EQ(rows.Text(1, 0), "other");
    rows.CaptureFile(0, "a much longer name", "C:\\x", {});
    EXPECT_EQ(rows.Text(0, 10), "a much longer name");
    EXPECT_EQ(rows.Text(1, 0), "other");
    rows.Clear();
    rows.CaptureFile(0, "x", "C:\\y", {});
    EXPECT_EQ(rows.Text(0, 6), "C:\\y");
}

TEST_F(FileViewRowsTest, NamesFillManyPages) {
    constexpr RowId count = 2'000;
    const std::string tail(200, 'x');
    for (RowId row = 0; row < count; ++row) rows.CaptureFile(row, std::to_string(row) + tail, "C:\\x", {});
    for (RowId row = 0; row < count; ++row) ASSERT_EQ(rows.Text(row, 0), std::to_string(row) + tail);
}

TEST_F(FileViewRowsTest, NamesThatAreNoUtf8StayAsTheyAre) {
    rows.CaptureFile(0, "a\xFF\nb", "C:\\x", {});
    EXPECT_EQ(rows.Text(0, 0), "a\xFF\nb");
    EXPECT_EQ(rows.Text(0, 12), "a\xFF\nb");
}

TEST_F(FileViewRowsTest, AColumnThatIsNotThereIsEmpty) {
    rows.CaptureFile(0, "a", "C:\\x", {});
    EXPECT_EQ(rows.Text(0, 11), "");
    EXPECT_EQ(rows.Text(0, 13), "");
}

TEST_F(FileViewRowsTest, ASizeWithoutANumberOfKilobytesIsEmptyAndStillSorts) {
    rows.CaptureFile(0, "a", "C:\\x", {.size = std::int64_t{1} << 50});
    EXPECT_EQ(rows.Text(0, 1), "");
    EXPECT_EQ(rows.Text(0, 7), "1125899906842624");
    EXPECT_EQ(rows.SortNumber(0, 7), std::nullopt);
}

TEST_F(FileViewRowsTest, FilesAreCountedSomeAtATime) {
    constexpr RowId count = 100;
    for (RowId row = 0; row < count; ++row) {
        lender.files.SetFile("C:\\x\\" + std::to_string(row) + "\\one", {}).Check();
        rows.CaptureFolder(row, std::to_string(row), "C:\\x", {}, Details::Hidden);
    }
    EXPECT_TRUE(rows.HasUncounted());
    rows.CountSome(30);
    EXPECT_TRUE(rows.HasUncounted());
    rows.CountSome(30);
    EXPECT_FALSE(rows.HasUncounted());
    EXPECT_EQ(rows.Text(99, 7), "000000000001");
}

}  // namespace
}  // namespace tessel::controls
