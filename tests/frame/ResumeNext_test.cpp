#include "frame/ResumeNext.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace tessel::frame {
namespace {

void Fail(int number) { throw ControlError(number); }

TEST(ResumeNext, RunsTheStatementBehindOneThatFailed) {
    ResumeNext next;
    int reached = 0;
    next([] { Fail(errors::elementNotFound); });
    next([&] { reached = 1; });
    EXPECT_EQ(reached, 1);
}

TEST(ResumeNext, HasNothingPendingAtFirstAndAfterStatementsThatSucceed) {
    ResumeNext next;
    EXPECT_FALSE(next.Failed());
    next([] {});
    next([]() -> Status { return {}; });
    EXPECT_FALSE(next.Failed());
    EXPECT_EQ(next.Number(), 0);
    EXPECT_EQ(next.Description(), "");
}

TEST(ResumeNext, SkipsTheRestOfAStatementThatFails) {
    ResumeNext next;
    int reached = 0;
    next([&] {
        Fail(errors::typeMismatch);
        reached = 1;
    });
    EXPECT_EQ(reached, 0);
    EXPECT_TRUE(next.Failed());
}

TEST(ResumeNext, KeepsNumberAndWordsOfAnError) {
    ResumeNext next;
    next([] { throw ControlError(errors::fileNotFound, "no such page"); });
    EXPECT_EQ(next.Number(), errors::fileNotFound);
    EXPECT_EQ(next.Description(), "no such page");
}

TEST(ResumeNext, TakesAFailedStatusAsAnErrorWithTheStandardWords) {
    ResumeNext next;
    next([]() -> Status { return errors::indexOutOfBounds; });
    EXPECT_EQ(next.Number(), errors::indexOutOfBounds);
    EXPECT_EQ(next.Description(), ErrorText(errors::indexOutOfBounds));
}

TEST(ResumeNext, KeepsAFailurePendingThroughLaterSuccesses) {
    ResumeNext next;
    next([] { Fail(errors::overflow); });
    next([] {});
    next([]() -> Status { return {}; });
    EXPECT_TRUE(next.If([] { return true; }));
    EXPECT_EQ(next.Value([] { return 1; }, 0), 1);
    EXPECT_EQ(next.Number(), errors::overflow);
}

TEST(ResumeNext, LetsALaterFailureTakeThePlaceOfAnEarlierOne) {
    ResumeNext next;
    next([] { Fail(errors::overflow); });
    next([] { Fail(errors::subscript); });
    EXPECT_EQ(next.Number(), errors::subscript);
    next([]() -> Status { return errors::keyInUse; });
    EXPECT_EQ(next.Number(), errors::keyInUse);
}

TEST(ResumeNext, ForgetsTheFailureWhenItIsCleared) {
    ResumeNext next;
    next([] { Fail(errors::overflow); });
    next.Clear();
    EXPECT_FALSE(next.Failed());
    EXPECT_EQ(next.Description(), "");
}

TEST(ResumeNext, GivesTheValueOfAnExpressionElseWhatTheVariableHeld) {
    ResumeNext next;
    EXPECT_EQ(next.Value([] { return 4; }, 9), 4);
    EXPECT_EQ(next.Value(
                  []() -> int {
                      Fail(errors::objectGone);
                      return 4;
                  },
                  9),
              9);
    EXPECT_EQ(next.Number(), errors::objectGone);
}

TEST(ResumeNext, FollowsTheAnswerOfATestThatSucceeds) {
    ResumeNext next;
    EXPECT_TRUE(next.If([] { return true; }));
    EXPECT_FALSE(next.If([] { return false; }));
}

TEST(ResumeNext, EntersTheBranchOfATestThatFails) {
    ResumeNext next;
    EXPECT_TRUE(next.If([]() -> bool {
        Fail(errors::noSuchMember);
        return false;
    }));
    EXPECT_EQ(next.Number(), errors::noSuchMember);
}

TEST(ResumeNext, TakesExhaustedMemoryAsItsNumber) {
    ResumeNext next;
    next([] { throw std::bad_alloc(); });
    EXPECT_EQ(next.Number(), errors::outOfMemory);
    EXPECT_EQ(next.Description(), ErrorText(errors::outOfMemory));
}

TEST(ResumeNext, LetsABugPass) {
    ResumeNext next;
    EXPECT_THROW(next([] { throw std::logic_error("a bug"); }), std::logic_error);
    EXPECT_FALSE(next.Failed());
}

}  // namespace
}  // namespace tessel::frame
