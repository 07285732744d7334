#include "screens/remote/snapshot.h"

#include <gtest/gtest.h>

#include "verification/unit/screens/sample_controller.h"

namespace wp::remote {
namespace {

class SnapshotTest : public testing::Test {
  protected:
    std::shared_ptr<SampleController> controller = std::make_shared<SampleController>();
    ui::Screen screen;
};

TEST_F(SnapshotTest, SaysNoneBeforeThereAreViews) {
    screen.setRootViewController(controller);

    EXPECT_EQ(snapshot(screen),
              R"({"alert":null,"description":null,"progress":null,"screen":"none","status":null,)"
              R"("table":null,"title":null})");
}

TEST_F(SnapshotTest, ShowsTheListWithItsFocus) {
    controller->buildViews();
    controller->description().setText("Pick one.");
    screen.setRootViewController(controller);
    screen.layoutIfNeeded();
    screen.focusPreferredView();

    screen.press(ui::Key::down);

    EXPECT_EQ(snapshot(screen),
              R"({"alert":null,"description":"Pick one.","progress":null,"screen":"list","status":null,)"
              R"("table":{"alpha":1.0,"sections":[)"
              R"({"header":"Selected network","rows":[{"enabled":true,"focused":false,"text":"Home"}]},)"
              R"({"header":"Choose a network","rows":[{"enabled":true,"focused":true,"text":"Café"},)"
              R"({"enabled":true,"focused":false,"text":"Office"}]},)"
              R"({"header":null,"rows":[{"enabled":true,"focused":false,"text":"Other ..."}]},)"
              R"({"header":null,"rows":[{"enabled":true,"focused":false,"text":"Refresh"}]}],)"
              R"("selectionEnabled":true},"title":"Wi-Fi Diagnostics"})");
}

TEST_F(SnapshotTest, ShowsAnAlertAndNoFocusedRowUnderIt) {
    controller->buildViews();
    screen.setRootViewController(controller);
    screen.focusPreferredView();

    controller->askForName();
    screen.typeText("a\"b");
    screen.press(ui::Key::down);

    std::string line = snapshot(screen);
    EXPECT_TRUE(line.starts_with(
        R"({"alert":{"actions":[{"enabled":true,"focused":true,"style":"cancel","title":"Cancel"},)"
        R"({"enabled":true,"focused":false,"style":"default","title":"Done"}],)"
        R"("message":"Type the network's name.","textField":{"placeholder":"Network name","text":"a\"b"},)"
        R"("title":null},)"))
        << line;
    EXPECT_EQ(line.find(R"("focused":true,"text")"), std::string::npos);
}

TEST_F(SnapshotTest, ShowsProgressInSinglePrecision) {
    controller->buildViews();
    screen.setRootViewController(controller);

    controller->showProgress(1, 11);

    std::string line = snapshot(screen);
    EXPECT_NE(line.find(R"("description":null,"progress":0.09090909,"screen":"progress")"), std::string::npos)
        << line;
    EXPECT_NE(line.find(R"("alpha":0.5)"), std::string::npos) << line;
    EXPECT_NE(line.find(R"("selectionEnabled":false)"), std::string::npos) << line;
}

TEST_F(SnapshotTest, HoldsNamesAsTheyAreOnOneLine) {
    controller->selected = "\x1B[2J\u202E\u2028\n";
    controller->buildViews();
    screen.setRootViewController(controller);

    std::string line = snapshot(screen);

    EXPECT_NE(line.find("\\u001b[2J\u202E\\u2028\\n"), std::string::npos) << line;
}

}  // namespace
}  // namespace wp::remote
