#include <gtest/gtest.h>

#include <memory>

#include "platform/ui/controls.h"
#include "platform/ui/label.h"
#include "platform/ui/layout_solver.h"

namespace wp::ui {
namespace {

using enum Attribute;
using enum Relation;

std::shared_ptr<View> addView(View& root, const char* identifier) {
    auto view = std::make_shared<View>();
    view->setIdentifier(identifier);
    view->setLaidOutByConstraints(true);
    root.addSubview(view);
    return view;
}

/// A root of 1000 by 1000 with one view in it.
struct OneView {
    std::shared_ptr<View> root = std::make_shared<View>(Rect{0, 0, 1000, 1000});
    std::shared_ptr<View> view = addView(*root, "box");

    Anchor box(Attribute attribute) { return {view.get(), attribute}; }
    Anchor whole(Attribute attribute) { return {root.get(), attribute}; }
    /// Left of the box given; only its width is open.
    void placeAllButWidth() {
        activateConstraints({{box(leading), equal, whole(leading), 10},
                             {box(top), equal, whole(top), 20},
                             {box(height), equal, {}, 30}});
    }
};

TEST(Layout, SolvesEdgesCentresAndSizes) {
    OneView given;
    activateConstraints({{given.box(centerX), equal, given.whole(centerX)},
                         {given.box(width), equal, {}, 100},
                         {given.box(bottom), equal, given.whole(bottom), -10},
                         {given.box(height), equal, given.box(width), 50}});

    LayoutReport report = solveLayout(*given.root);

    EXPECT_EQ(given.view->frame(), (Rect{450, 840, 100, 150}));
    EXPECT_TRUE(report.conflicts.empty());
    EXPECT_TRUE(report.ambiguous.empty());
}

TEST(Layout, ReportsRequiredConstraintsThatCannotHoldAndKeepsTheEarlierOnes) {
    OneView given;
    given.placeAllButWidth();
    activateConstraints({{given.box(width), equal, {}, 100}, {given.box(width), equal, {}, 200}});

    LayoutReport report = solveLayout(*given.root);

    EXPECT_EQ(report.conflicts, std::vector<std::string>{"box.width = 200"});
    EXPECT_EQ(given.view->frame().width, 100);
}

TEST(Layout, LetsALowerPriorityGiveWayWithoutAReport) {
    OneView given;
    given.placeAllButWidth();
    activateConstraints({{given.box(width), equal, {}, 200, 500}, {given.box(width), equal, {}, 100}});

    LayoutReport report = solveLayout(*given.root);

    EXPECT_TRUE(report.conflicts.empty());
    EXPECT_EQ(given.view->frame().width, 100);
}

TEST(Layout, ReportsWhatNothingDecides) {
    OneView given;
    given.placeAllButWidth();

    LayoutReport report = solveLayout(*given.root);

    EXPECT_EQ(report.ambiguous, std::vector<std::string>{"box.width"});
    EXPECT_EQ(given.view->frame().width, 0);
}

TEST(Layout, LeavesAnInequalityAloneThatHolds) {
    OneView given;
    given.placeAllButWidth();
    activateConstraints(
        {{given.box(width), greaterOrEqual, {}, 100}, {given.box(width), equal, {}, 300, 500}});

    solveLayout(*given.root);

    EXPECT_EQ(given.view->frame().width, 300);
}

TEST(Layout, HoldsAnInequalityThatWouldBeViolated) {
    OneView given;
    given.placeAllButWidth();
    activateConstraints(
        {{given.box(width), greaterOrEqual, {}, 100}, {given.box(width), equal, {}, 30, 500}});

    LayoutReport report = solveLayout(*given.root);

    EXPECT_EQ(given.view->frame().width, 100);
    EXPECT_TRUE(report.conflicts.empty());
}

TEST(Layout, PlacesWhatOnlyAnInequalityBoundsAtTheBound) {
    OneView given;
    given.placeAllButWidth();
    activateConstraints({{given.box(width), greaterOrEqual, {}, 77}});

    LayoutReport report = solveLayout(*given.root);

    EXPECT_EQ(given.view->frame().width, 77);
    EXPECT_TRUE(report.ambiguous.empty());
}

TEST(Layout, ReportsInequalitiesThatContradictOneAnother) {
    OneView given;
    given.placeAllButWidth();
    activateConstraints({{given.box(width), equal, {}, 50}, {given.box(width), greaterOrEqual, {}, 60}});

    LayoutReport report = solveLayout(*given.root);

    EXPECT_EQ(report.conflicts, std::vector<std::string>{"box.width >= 60"});
}

TEST(Layout, PullsTowardsTheContentsSizeAndNeverBelowIt) {
    auto root = std::make_shared<View>(Rect{0, 0, 1000, 1000});
    auto label = std::make_shared<Label>();
    label->setText("ten chars!");
    label->setFont(Font::body());
    label->setLaidOutByConstraints(true);
    root->addSubview(label);
    activateConstraints({{{label.get(), leading}, equal, {root.get(), leading}},
                         {{label.get(), top}, equal, {root.get(), top}},
                         {{label.get(), width}, equal, {}, 20, 500}});

    solveLayout(*root);

    // The wish of 20 points outranks hugging and is outranked by the resistance against being cut.
    EXPECT_EQ(label->frame(), (Rect{0, 0, 145, 34}));
}

TEST(Layout, GivesWrappingTextItsHeightAtTheWidthThatComesOut) {
    auto root = std::make_shared<View>(Rect{0, 0, 290, 1000});
    auto label = std::make_shared<Label>();
    label->setText("one two three four five six seven");
    label->setFont(Font::body());
    label->setNumberOfLines(5);
    label->setLaidOutByConstraints(true);
    root->addSubview(label);
    activateConstraints({{{label.get(), leading}, equal, {root.get(), leading}},
                         {{label.get(), top}, equal, {root.get(), top}},
                         {{label.get(), width}, equal, {root.get(), width}}});

    solveLayout(*root);

    EXPECT_EQ(label->frame(), (Rect{0, 0, 290, 68}));
}

TEST(Layout, GivesNestedViewsFramesInTheirSuperviews) {
    OneView given;
    activateConstraints({{given.box(leading), equal, given.whole(leading), 100},
                         {given.box(top), equal, given.whole(top), 100},
                         {given.box(width), equal, {}, 200},
                         {given.box(height), equal, {}, 200}});
    auto inner = addView(*given.view, "inner");
    activateConstraints({{{inner.get(), trailing}, equal, given.whole(trailing), -10},
                         {{inner.get(), top}, equal, given.box(top), 5},
                         {{inner.get(), width}, equal, {}, 20},
                         {{inner.get(), height}, equal, {}, 20}});

    solveLayout(*given.root);

    EXPECT_EQ(inner->frame(), (Rect{870, 5, 20, 20}));
    EXPECT_EQ(inner->frameOnScreen(), (Rect{970, 105, 20, 20}));
}

TEST(Layout, RejectsConstraintsBetweenViewsThatShareNoTree) {
    OneView given;
    OneView other;

    auto rejected = activateConstraints({{given.box(top), equal, other.box(top)}});

    EXPECT_EQ(rejected.size(), 1u);
}

TEST(Layout, ForgetsTheConstraintsOfAViewThatIsTakenOut) {
    OneView given;
    given.placeAllButWidth();

    given.view->removeFromSuperview();

    EXPECT_TRUE(given.root->constraints().empty());
    EXPECT_EQ(given.view->constraints().size(), 1u);
    EXPECT_EQ(given.view->superview(), nullptr);
}

TEST(Layout, AHiddenViewKeepsItsPlace) {
    OneView given;
    given.placeAllButWidth();
    activateConstraints({{given.box(width), equal, {}, 100}});

    given.view->setHidden(true);
    given.root->layoutIfNeeded();

    EXPECT_EQ(given.view->frame(), (Rect{10, 20, 100, 30}));
}

TEST(View, AFlexibleWidthFollowsTheSuperviews) {
    auto root = std::make_shared<View>(Rect{0, 0, 100, 100});
    auto flexible = std::make_shared<View>(Rect{10, 10, 50, 10});
    flexible->setAutoresizingMask(View::kFlexibleWidth);
    root->addSubview(flexible);

    root->setFrame({0, 0, 160, 100});

    EXPECT_EQ(flexible->frame(), (Rect{10, 10, 110, 10}));
}

TEST(Label, ShrinksToFitItsLinesButNotBelowWhatCanBeRead) {
    Label label({0, 0, 290, 68});
    label.setFont(Font::body());
    label.setNumberOfLines(1);
    label.setText(std::string(20, 'x'));
    EXPECT_EQ(label.fittingFont().size, 29);

    label.setAdjustsFontSizeToFitWidth(true);
    label.setText(std::string(22, 'x'));
    EXPECT_EQ(label.fittingFont().size, 26);
    label.setText(std::string(60, 'x'));
    EXPECT_EQ(label.fittingFont().size, 24);
}

TEST(Progress, StaysBetweenNothingAndAll) {
    ProgressView view;
    for (auto [given, expected] : {std::pair{0.25F, 0.25F}, {-1.0F, 0.0F}, {7.0F, 1.0F}}) {
        view.setProgress(given);
        EXPECT_EQ(view.progress(), expected);
    }
    view.setProgress(0.0F / 0.0F);
    EXPECT_EQ(view.progress(), 0.0F);
}

}  // namespace
}  // namespace wp::ui
