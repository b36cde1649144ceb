#include <gtest/gtest.h>

#include <memory>
#include <random>
#include <string>
#include <vector>

#include "frame/Text.h"
#include "hosts/headless/HeadlessHost.h"
#include "hosts/headless/HostObject.h"

namespace tessel::headless {
namespace {

using frame::Variant;

/// The search as the rule has it.
frame::Object* Searched(frame::Siblings& siblings, const std::string& name, int index) {
    return siblings.Siblings::Find(name, index);
}

TEST(Siblings, FindGivesTheFirstOfANameInAnyCase) {
    HeadlessHost host;
    HostObject one("one", {{"Name", "Text1"}}), two("two", {{"Name", "TEXT1"}}), nameless("nameless", {{"Left", 1}});
    for (HostObject* object : {&nameless, &one, &two}) host.Form().Add(*object);
    EXPECT_EQ(host.Form().Find("text1"), &one);
    EXPECT_EQ(host.Form().Find("text2"), nullptr);
    EXPECT_EQ(host.Form().Find(""), nullptr);
}

TEST(Siblings, FindByIndexPassesOverWhatHasNone) {
    HeadlessHost host;
    HostObject none("none", {{"Name", "B"}}), zero("zero", {{"Name", "B"}, {"Index", 0}}),
        two("two", {{"Name", "b"}, {"Index", 2.0}});
    for (HostObject* object : {&none, &zero, &two}) host.Form().Add(*object);
    EXPECT_EQ(host.Form().Find("B"), &none);
    EXPECT_EQ(host.Form().Find("B", 0), &zero);
    EXPECT_EQ(host.Form().Find("B", 2), &two);
    EXPECT_EQ(host.Form().Find("B", 1), nullptr);
    EXPECT_EQ(host.Form().Find("B", -5), &none);
}

TEST(Siblings, FindIsTheSearchWhateverHappensToTheSiblings) {
    HeadlessHost host;
    HeadlessForm& form = host.Form();
    std::mt19937 random(7);
    const auto below = [&](int bound) { return static_cast<int>(random() % static_cast<unsigned>(bound)); };
    const auto name = [&] { return std::string(1, static_cast<char>((below(2) ? 'a' : 'A') + below(6))); };
    std::vector<std::unique_ptr<HostObject>> objects;
    int found = 0;
    for (int step = 0; step < 3'000; ++step) {
        const auto any = [&]() -> HostObject& {
            return *objects[static_cast<std::size_t>(below(static_cast<int>(objects.size())))];
        };
        switch (objects.empty() ? 0 : below(8)) {
            case 0:
                if (objects.size() > 40) break;
                objects.push_back(std::make_unique<HostObject>("x", HostObject::Members{}));
                if (below(4)) objects.back()->SetMember("Name", name());
                form.Add(*objects.back());
                break;
            case 1: {
                const auto at = objects.begin() + below(static_cast<int>(objects.size()));
                if (below(2)) form.Remove(**at);  // or it goes without a word
                objects.erase(at);
                break;
            }
            case 2:
                any().SetMember("Name", name());
                break;
            case 3:
                any().SetMember("Index", below(3) ? Variant(below(3)) : Variant("no number"));
                break;
            default:
                break;
        }
        const std::string wanted = name();
        const int index = below(4) - 1;
        frame::Object* const expected = Searched(form, wanted, index);
        ASSERT_EQ(form.Find(wanted, index), expected) << "step " << step;
        if (expected) ++found;
    }
    EXPECT_GT(found, 500);
}

}  // namespace
}  // namespace tessel::headless
