#include "frame/child/ImageList.h"

#include <gtest/gtest.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "hosts/headless/HeadlessHost.h"
#include "tests/ErrorOf.h"
#include "tests/frame/child/ListOwner.h"

namespace tessel::child {
namespace {

using frame::ObjectRef;
using frame::Picture;
using frame::PictureRef;
using frame::PixelPlane;
using frame::Variant;
using test::ErrorOf;
using test::ListOwner;
namespace errors = frame::errors;

constexpr std::uint32_t grey = 0xFFC0C0C0u, red = 0xFF0000FFu;

PictureRef Sized(float width, float height) { return std::make_shared<Picture>(width, height, ""); }
PictureRef Small() { return Sized(240, 240); }

class ImageListTest : public testing::Test {
  protected:
    ImageListTest() : owner(&host.Create<ListOwner>("FileView1")) {}

    ImageList& List() { return owner->Image16; }
    ListImages& Images() { return List().ListImages; }
    ListImage& Add(const char* key) { return Images().Add({}, key, Small()); }
    /// The keys in their order; "-" for none.
    std::string Keys() {
        std::string keys;
        for (int index = 1; index <= Images().Count(); ++index) {
            const ListImage& image = Images().Item(index);
            EXPECT_EQ(image.Index(), index);
            keys += (index > 1 ? " " : "") + (image.Key().empty() ? "-" : image.Key());
        }
        return keys;
    }

    headless::HeadlessHost host;
    ListOwner* owner;
};

TEST_F(ImageListTest, AddGivesTheImageBehindAllOthersOrAtItsIndex) {
    EXPECT_EQ(Add("a").Index(), 1);
    EXPECT_EQ(Add("b").Index(), 2);
    EXPECT_EQ(Images().Add(1, "c", Small()).Index(), 1);
    EXPECT_EQ(Images().Add(4, "d", Small()).Index(), 4);
    EXPECT_EQ(Keys(), "c a b d");
    for (const int index : {-1, 0, 6}) EXPECT_EQ(ErrorOf([&] { Images().Add(index, "e", Small()); }), errors::indexOutOfBounds);
    EXPECT_EQ(Images().Count(), 4);
}

TEST_F(ImageListTest, AKeyIsFoundWithoutRegardToCaseAndKeepsItsSpelling) {
    const PictureRef picture = Small();
    Images().Add({}, "txt", picture);
    EXPECT_EQ(Images().Item("TXT").Picture(), picture);
    EXPECT_EQ(Images().Item("TXT").Key(), "txt");
    EXPECT_TRUE(List().Keys().Has("Txt"));
    EXPECT_EQ(ErrorOf([&] { Images().Item("doc"); }), errors::elementNotFound);
    EXPECT_EQ(ErrorOf([&] { Images().Remove("doc"); }), errors::elementNotFound);
}

TEST_F(ImageListTest, AKeyThatIsThereAlreadyLeavesTheListAsItWas) {
    const PictureRef picture = Small();
    Images().Add({}, "txt", picture);
    EXPECT_EQ(ErrorOf([&] { Add("TXT"); }), errors::keyNotUnique);
    EXPECT_EQ(Keys(), "txt");
    EXPECT_EQ(Images().Item(1).Picture(), picture);
}

TEST_F(ImageListTest, AnyNumberOfImagesHasNoKey) {
    Add("");
    Images().Add({}, {}, Small());
    EXPECT_EQ(Keys(), "- -");
    EXPECT_EQ(ErrorOf([&] { Images().Item(""); }), errors::elementNotFound);
    EXPECT_FALSE(List().Keys().Has(""));
    EXPECT_EQ(List().Keys().Count(), 2);
}

TEST_F(ImageListTest, AStringIsAlwaysAKeyAndANumberAlwaysAnIndex) {
    Add("2");
    Add("1");
    EXPECT_EQ(Images().Item("1").Index(), 2);
    EXPECT_EQ(Images().Item(1).Key(), "2");
    EXPECT_EQ(Images().Item(2.0).Key(), "1");
    for (const int index : {-1, 0, 3}) {
        EXPECT_EQ(ErrorOf([&] { Images().Item(index); }), errors::indexOutOfBounds);
        EXPECT_EQ(ErrorOf([&] { Images().Remove(index); }), errors::indexOutOfBounds);
    }
}

TEST_F(ImageListTest, RemoveByIndexAndByKeyClosesTheGap) {
    for (const char* key : {"a", "b", "c", "d"}) Add(key);
    Images().Remove(2);
    Images().Remove("C");
    EXPECT_EQ(Keys(), "a d");
    EXPECT_FALSE(List().Keys().Has("b"));
    Add("b");
    EXPECT_EQ(Keys(), "a d b");
    Images().Clear();
    EXPECT_EQ(Images().Count(), 0);
    EXPECT_FALSE(List().Keys().Has("a"));
}

TEST_F(ImageListTest, ImagesMarkedByTheirTagGoFromTheLastToTheFirst) {
    for (const char* key : {"txt", "a.exe", "doc", "b.exe", "c.exe"}) Add(key);
    for (const char* key : {"a.exe", "b.exe", "c.exe"}) Images().Item(key).SetTag("exe");
    for (int index = Images().Count(); index >= 1; --index)
        if (Images().Item(index).Tag() == Variant("exe")) Images().Remove(index);
    EXPECT_EQ(Keys(), "txt doc");
    EXPECT_TRUE(Images().Item(1).Tag().IsEmpty());
}

TEST_F(ImageListTest, AKeyCanBeChangedToOneThatIsFree) {
    ListImage& image = Add("exe");
    Add("txt");
    image.SetKey("Setup.exe");
    EXPECT_EQ(Images().Item("setup.EXE").Index(), 1);
    EXPECT_FALSE(List().Keys().Has("exe"));
    EXPECT_EQ(ErrorOf([&] { image.SetKey("TXT"); }), errors::keyNotUnique);
    EXPECT_EQ(image.Key(), "Setup.exe");
    image.SetKey("SETUP.exe");
    EXPECT_EQ(Keys(), "SETUP.exe txt");
    image.SetKey("");
    EXPECT_EQ(Keys(), "- txt");
    Add("setup.exe");
}

TEST_F(ImageListTest, WithoutAPictureThereIsNoImage) {
    EXPECT_EQ(ErrorOf([&] { Images().Add({}, "a", nullptr); }), errors::invalidPicture);
    EXPECT_EQ(Images().Count(), 0);
    EXPECT_EQ(ErrorOf([&] { Add("a").SetPicture(nullptr); }), errors::invalidPicture);
}

TEST_F(ImageListTest, TheFirstImageGivesTheSizeWhereNoneWasSet) {
    Images().Add({}, "a", Sized(480, 240));
    EXPECT_EQ(List().ImageWidth(), 32);
    EXPECT_EQ(List().ImageHeight(), 16);
    Images().Add({}, "b", Sized(1500, 1500));
    EXPECT_EQ(List().ImageWidth(), 32);
}

TEST_F(ImageListTest, OnlyAnEmptyListTakesAnotherSize) {
    List().SetImageWidth(16);
    List().SetImageHeight(16);
    Images().Add({}, "a", Sized(480, 480));
    EXPECT_EQ(List().ImageWidth(), 16);
    EXPECT_EQ(ErrorOf([&] { List().SetImageWidth(32); }), errors::invalidValue);
    EXPECT_EQ(ErrorOf([&] { List().SetImageHeight(32); }), errors::invalidValue);
    List().SetImageWidth(16);
    Images().Clear();
    EXPECT_EQ(ErrorOf([&] { List().SetImageWidth(-1); }), errors::invalidValue);
    List().SetImageWidth(32);
    EXPECT_EQ(List().ImageWidth(), 32);
    EXPECT_EQ(List().ImageHeight(), 16);
}

TEST_F(ImageListTest, PixelsOfTheMaskColourAreClearWhereTheImageIsShown) {
    const PixelPlane one{1, 2, 1, {grey, red}}, two{2, 4, 1, {red, grey, 0x80C0C0C0u, red}};
    const auto picture = std::make_shared<Picture>(std::vector{one, two}, "p");
    ListImage& image = Images().Add({}, "a", picture);
    EXPECT_EQ(image.Picture(), picture);
    const PictureRef shown = image.ShownPicture();
    EXPECT_EQ(shown->Plane(1)->pixels, (std::vector<std::uint32_t>{0, red}));
    EXPECT_EQ(shown->Plane(2)->pixels, (std::vector<std::uint32_t>{red, 0, 0, red}));
    EXPECT_EQ(shown->Width(), picture->Width());
    EXPECT_EQ(shown->Source(), "p");
    EXPECT_EQ(image.ShownPicture(), shown);

    List().SetMaskColor(red & 0xFFFFFFu);
    EXPECT_EQ(image.ShownPicture()->Plane(1)->pixels, (std::vector<std::uint32_t>{grey, 0}));
    List().SetUseMaskColor(false);
    EXPECT_EQ(image.ShownPicture(), picture);
    List().SetUseMaskColor(true);
    image.SetPicture(Small());
    EXPECT_EQ(image.ShownPicture(), image.Picture());  // it has no pixels
}

TEST_F(ImageListTest, AHostFindsTheImageOfAPicture) {
    const PictureRef picture = Small();
    Add("a");
    Images().Add({}, "Smiley3", picture);
    EXPECT_EQ(Images().FindPicture(*picture)->Path(), "FileView1.Image16.ListImages(\"Smiley3\")");
    EXPECT_EQ(Images().FindPicture(*Small()), nullptr);
}

TEST_F(ImageListTest, HoldersHearOfEachChangeAndOfTheEnd) {
    ListOwner& other = host.Create<ListOwner>("FileView2");
    int changes = 0;
    ImageListHolder holder([&] { ++changes; });
    holder.Set(&other.Image16);
    EXPECT_EQ(changes, 0);
    const std::uint32_t before = other.Image16.Revision();
    ListImage& image = other.Image16.ListImages.Add({}, "a", Small());
    image.SetKey("b");
    image.SetPicture(Small());
    other.Image16.SetMaskColor(1);
    other.Image16.ListImages.Remove(1);
    EXPECT_EQ(changes, 5);
    EXPECT_NE(other.Image16.Revision(), before);
}

TEST_F(ImageListTest, AListThatGoesLeavesItsHoldersWithNone) {
    ListOwner& other = host.Create<ListOwner>("FileView2");
    int changes = 0;
    ImageListHolder holder([&] { ++changes; });
    holder.Set(&other.Image16);
    host.Destroy(other);
    EXPECT_EQ(holder.Get(), nullptr);
    EXPECT_EQ(changes, 1);
    holder.Set(&List());
    Add("a");
    EXPECT_EQ(changes, 2);
}

TEST_F(ImageListTest, EverythingIsReachedByName) {
    frame::Object& list = *owner->Inner("image16");
    const ObjectRef images = list.Inner("ListImages");
    EXPECT_EQ(images->Path(), "FileView1.Image16.ListImages");
    Variant added[] = {Variant::Missing(), "txt", Small()};
    const ObjectRef image = images->Call("Add", added).ToObject();
    EXPECT_EQ(image->Path(), "FileView1.Image16.ListImages(\"txt\")");
    EXPECT_EQ(images->Get("Count"), Variant(1));
    Variant key[] = {"TXT"};
    EXPECT_EQ(images->Call("Item", key), Variant(image));
    image->Put("Tag", "exe");
    EXPECT_EQ(image->Get("Tag"), Variant("exe"));
    EXPECT_EQ(image->Get("Index"), Variant(1));
    image->Put("Key", "");
    EXPECT_EQ(image->Path(), "FileView1.Image16.ListImages(1)");
    EXPECT_EQ(ErrorOf([&] {
                  images->Call("Add", added);
                  images->Call("Add", added);
              }),
              errors::keyNotUnique);
    Variant noPicture[] = {Variant::Missing(), "doc", 5};
    EXPECT_EQ(ErrorOf([&] { images->Call("Add", noPicture); }), errors::objectRequired);
    images->Call("Remove", key);
    EXPECT_EQ(list.Get("ImageWidth"), Variant(16));
    images->Call("Clear");
    EXPECT_EQ(ErrorOf([&] { image->Get("Key"); }), errors::objectGone);
}

}  // namespace
}  // namespace tessel::child
