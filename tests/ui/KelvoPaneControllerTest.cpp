#include "ui/KelvoPaneController.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QSignalSpy>

#include "tests/ui/FakeHost.h"
#include "ui/NavigationStack.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using Kind = ToolbarItem::Kind;

NodeRef treeOf(const Value& display) {
    NodesByPath nodes;
    return KelvoModelNode::makeTreeFromObject(display, nodes);
}

Value branch() { return Dictionary::make({{"Cell ID", "1"}}); }

class Pane : public testing::Test {
protected:
    /// A pane at the bottom of a stack.
    KelvoPaneController& paneOf(const Value& display) { return paneOf(treeOf(display)); }
    KelvoPaneController& paneOf(NodeRef node) {
        stack = std::make_unique<NavigationStack>(std::make_unique<KelvoPaneController>(std::move(node), "/", host));
        tester = std::make_unique<QAbstractItemModelTester>(&stack->topViewController(),
                                                            QAbstractItemModelTester::FailureReportingMode::Warning);
        return stack->topViewController();
    }
    /// "key=value" of a leaf and "key>" of a child with children.
    static std::vector<std::string> rows(const KelvoPaneController& pane) {
        std::vector<std::string> texts;
        for (int row = 0; row < pane.rowCount(); ++row) {
            const auto text = [&](int role) { return pane.data(pane.index(row), role).toString().toStdString(); };
            const bool opens = pane.data(pane.index(row), KelvoPaneController::OpensRole).toBool();
            texts.push_back(text(KelvoPaneController::KeyRole) +
                            (opens ? ">" : "=" + text(KelvoPaneController::ValueRole)));
        }
        return texts;
    }
    static std::vector<std::string> fresh(const KelvoPaneController& pane) {
        std::vector<std::string> keys;
        for (int row = 0; row < pane.rowCount(); ++row) {
            const QModelIndex at = pane.index(row);
            if (pane.data(at, KelvoPaneController::FreshRole).toBool())
                keys.push_back(pane.data(at, KelvoPaneController::KeyRole).toString().toStdString());
        }
        return keys;
    }
    static std::vector<Kind> toolbar(const KelvoPaneController& pane) {
        std::vector<Kind> kinds;
        for (const ToolbarItem& item : pane.toolbarItems()) kinds.push_back(item.kind);
        return kinds;
    }

    test::FakeHost host;
    std::unique_ptr<NavigationStack> stack;
    std::unique_ptr<QAbstractItemModelTester> tester;
};

using Rows = std::vector<std::string>;

TEST_F(Pane, WithoutANodeIsCalledKelvoAndIsEmpty) {
    KelvoPaneController& pane = paneOf(NodeRef());
    EXPECT_EQ(pane.title(), QStringLiteral("Kelvo"));
    EXPECT_EQ(pane.rowCount(), 0);
    EXPECT_EQ(pane.path(), "/");
    EXPECT_TRUE(pane.status().isEmpty());
    EXPECT_FALSE(pane.status().isNull());
    EXPECT_TRUE(pane.isLoading());
    EXPECT_FALSE(pane.emptyText().isEmpty());
}

TEST_F(Pane, ShowsOneRowPerChildOfItsNode) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"Serving Cell", branch()}, {"State", "Traffic [8]"}}));
    EXPECT_EQ(rows(pane), (Rows{"Serving Cell>", "State=Traffic [8]"}));
    EXPECT_TRUE(pane.emptyText().isEmpty());
}

TEST_F(Pane, OpensAnEmptyListAndSaysThatNothingWasReported) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"Cells", Array::make()}}));
    EXPECT_EQ(rows(pane), Rows{"Cells>"});
    pane.didSelectRow(0);
    EXPECT_EQ(stack->topViewController().rowCount(), 0);
    EXPECT_EQ(stack->topViewController().emptyText(), QStringLiteral("None reported"));
}

TEST_F(Pane, HasNoRowsForANodeThatIsALeaf) {
    KelvoPaneController& pane = paneOf(Value());
    EXPECT_EQ(pane.title(), QStringLiteral("Kelvo"));
    EXPECT_EQ(pane.rowCount(), 0);
}

TEST_F(Pane, HasThreeToolbarItemsWithoutTheSavePermission) {
    EXPECT_EQ(toolbar(paneOf(branch())),
              (std::vector{Kind::ActivityIndicator, Kind::StatusLabel, Kind::FlexibleSpace}));
}

TEST_F(Pane, HasFourToolbarItemsWithIt) {
    host.savingAllowed = true;
    KelvoPaneController& pane = paneOf(branch());
    EXPECT_EQ(toolbar(pane),
              (std::vector{Kind::ActivityIndicator, Kind::StatusLabel, Kind::FlexibleSpace, Kind::SaveButton}));
    pane.saveButtonPressed();
    EXPECT_EQ(host.saveViewsShown, 1);
}

TEST_F(Pane, AsksForNoSaveScreenWithoutThePermission) {
    paneOf(branch()).saveButtonPressed();
    EXPECT_EQ(host.saveViewsShown, 0);
}

TEST_F(Pane, SpinsExactlyWhileItIsLoading) {
    KelvoPaneController& pane = paneOf(branch());
    pane.setStatus(QStringLiteral("Connecting..."), true);
    EXPECT_TRUE(pane.toolbarItems()[0].spinning);
    EXPECT_EQ(pane.toolbarItems()[1].text, QStringLiteral("Connecting..."));
    pane.setStatus(QString(), false);
    EXPECT_FALSE(pane.toolbarItems()[0].spinning);
    EXPECT_EQ(pane.toolbarItems()[1].text, QStringLiteral(""));
    EXPECT_FALSE(pane.status().isNull());
}

TEST_F(Pane, PushesTheChildsPaneWithItsOwnStatus) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"Serving Cell", branch()}}));
    pane.setStatus(QStringLiteral("Updated"), false);
    pane.didSelectRow(1);
    ASSERT_EQ(stack->viewControllers().size(), 2U);
    KelvoPaneController& child = stack->topViewController();
    EXPECT_EQ(child.path(), "/Serving Cell");
    EXPECT_EQ(child.title(), QStringLiteral("Serving Cell"));
    EXPECT_EQ(child.backTitle(), QStringLiteral("Kelvo"));
    EXPECT_EQ(child.status(), QStringLiteral("Updated"));
    EXPECT_FALSE(child.isLoading());
    EXPECT_EQ(pane.selectedRow(), 1);  // until it is seen again
    stack->popViewController();
    EXPECT_EQ(pane.selectedRow(), -1);
}

TEST_F(Pane, TakesThePathOfAPaneFurtherUpFromTheOneBelow) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"Cells", Array::make({branch()})}}));
    pane.didSelectRow(0);
    stack->topViewController().didSelectRow(0);
    EXPECT_EQ(stack->topViewController().path(), "/Cells/0");
    EXPECT_EQ(stack->topViewController().backTitle(), QStringLiteral("Cells"));
}

TEST_F(Pane, OnlyTakesTheHighlightFromALeaf) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"State", "Idle"}}));
    const QSignalSpy highlights(&pane, &KelvoPaneController::selectedRowChanged);
    pane.didSelectRow(0);
    EXPECT_EQ(stack->viewControllers().size(), 1U);
    EXPECT_EQ(pane.selectedRow(), -1);
    EXPECT_EQ(highlights.count(), 2);
}

TEST_F(Pane, IgnoresRowsThatAreNotThereAndTapsOnAPaneThatIsCovered) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"Cells", branch()}}));
    pane.didSelectRow(-1);
    pane.didSelectRow(1);
    EXPECT_EQ(stack->viewControllers().size(), 1U);
    pane.didSelectRow(0);
    pane.didSelectRow(0);
    EXPECT_EQ(stack->viewControllers().size(), 2U);
}

TEST_F(Pane, ChangesOnlyTheValuesThatDiffer) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    const QSignalSpy changed(&pane, &QAbstractItemModel::dataChanged);
    const QSignalSpy inserted(&pane, &QAbstractItemModel::rowsInserted);
    const QSignalSpy removed(&pane, &QAbstractItemModel::rowsRemoved);
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", "1"}, {"B", "5"}, {"C", "3"}})));
    ASSERT_EQ(changed.count(), 1);
    EXPECT_EQ(changed[0][0].toModelIndex().row(), 1);
    EXPECT_EQ(inserted.count() + removed.count(), 0);
    EXPECT_EQ(rows(pane), (Rows{"A=1", "B=5", "C=3"}));
}

TEST_F(Pane, CallsAChangedValueFreshForAMoment) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    EXPECT_EQ(fresh(pane), Rows{});
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", "1"}, {"B", "5"}, {"C", "3"}, {"D", "new"}})));
    EXPECT_EQ(fresh(pane), Rows{"B"});
    host.tasks.advance(899ms);
    EXPECT_EQ(fresh(pane), Rows{"B"});
    host.tasks.advance(1ms);
    EXPECT_EQ(fresh(pane), Rows{});
    EXPECT_EQ(rows(pane), (Rows{"A=1", "B=5", "C=3", "D=new"}));
}

TEST_F(Pane, GivesEveryReloadItsOwnMoment) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"B", "2"}}));
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", "3"}, {"B", "2"}})));
    host.tasks.advance(500ms);
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", "3"}, {"B", "4"}})));
    EXPECT_EQ(fresh(pane), Rows{"B"});
    host.tasks.advance(500ms);
    EXPECT_EQ(fresh(pane), Rows{"B"});
    host.tasks.advance(400ms);
    EXPECT_EQ(fresh(pane), Rows{});
}

TEST_F(Pane, MayGoWhileAValueIsFresh) {
    paneOf(Dictionary::make({{"A", "1"}})).reloadWithNode(treeOf(Dictionary::make({{"A", "2"}})));
    tester.reset();
    stack.reset();
    host.tasks.advance(1s);
}

TEST_F(Pane, KeepsTheHighlightOnItsRowWhenOthersComeAndGo) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"Cells", branch()}, {"Z", "2"}}));
    pane.didSelectRow(1);
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", "1"}, {"B", "1"}, {"Cells", branch()}, {"Z", "2"}})));
    EXPECT_EQ(pane.selectedRow(), 2);
    pane.reloadWithNode(treeOf(Dictionary::make({{"Cells", branch()}, {"Y", "1"}, {"Z", "2"}})));
    EXPECT_EQ(pane.selectedRow(), 0);
    pane.reloadWithNode(treeOf(Dictionary::make({{"Y", "1"}, {"Z", "2"}})));
    EXPECT_EQ(pane.selectedRow(), -1);
}

TEST_F(Pane, ChangesRowsInSeveralPlacesAndLeavesThoseBetweenAlone) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}, {"D", "4"}, {"E", "5"}}));
    const QPersistentModelIndex kept(pane.index(2));
    const QSignalSpy inserted(&pane, &QAbstractItemModel::rowsInserted);
    const QSignalSpy removed(&pane, &QAbstractItemModel::rowsRemoved);
    pane.reloadWithNode(treeOf(Dictionary::make({{"X", "0"}, {"A", "1"}, {"C", "3"}, {"E", "5"}, {"Y", "6"}})));
    EXPECT_EQ(rows(pane), (Rows{"X=0", "A=1", "C=3", "E=5", "Y=6"}));
    EXPECT_EQ(kept.row(), 2);
    EXPECT_EQ(kept.data(KelvoPaneController::KeyRole).toString(), QStringLiteral("C"));
    EXPECT_EQ(inserted.count(), 2);
    EXPECT_EQ(removed.count(), 2);
}

TEST_F(Pane, FollowsChildrenThatChangePlaces) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    pane.reloadWithNode(treeOf(Dictionary::make({{"C", "3"}, {"A", "1"}, {"B", "9"}})));
    EXPECT_EQ(rows(pane), (Rows{"C=3", "A=1", "B=9"}));
}

TEST_F(Pane, InsertsAndRemovesOnlyWhatCameAndWent) {
    KelvoPaneController& pane = paneOf(Array::make({branch(), branch()}));
    const QSignalSpy reset(&pane, &QAbstractItemModel::modelReset);
    const QSignalSpy inserted(&pane, &QAbstractItemModel::rowsInserted);
    const QSignalSpy removed(&pane, &QAbstractItemModel::rowsRemoved);
    pane.reloadWithNode(treeOf(Array::make({branch(), branch(), branch(), branch()})));
    EXPECT_EQ(rows(pane), (Rows{"0>", "1>", "2>", "3>"}));
    pane.reloadWithNode(treeOf(Array::make({branch()})));
    EXPECT_EQ(rows(pane), Rows{"0>"});
    EXPECT_EQ(inserted.count(), 1);
    EXPECT_EQ(removed.count(), 1);
    EXPECT_EQ(reset.count(), 0);
}

TEST_F(Pane, BeginsAnewWithAListBeyondAnyModems) {
    const auto numbered = [](const char* name, const char* value) {
        const DictionaryRef display = Dictionary::make();
        for (int row = 0; row < 2500; ++row) display->set(name + std::to_string(row), value);
        return treeOf(display);
    };
    KelvoPaneController& pane = paneOf(numbered("a", "1"));
    QSignalSpy resets(&pane, &QAbstractItemModel::modelReset);
    pane.reloadWithNode(numbered("a", "2"));
    EXPECT_EQ(resets.count(), 0);  // the same children
    pane.reloadWithNode(numbered("b", "3"));
    EXPECT_EQ(resets.count(), 1);
    EXPECT_EQ(rows(pane).back(), "b2499=3");
    EXPECT_EQ(pane.rowCount(), 2500);
}

TEST_F(Pane, KeepsRowsAroundOneThatWentInTheMiddle) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}, {"D", "4"}}));
    const QSignalSpy removed(&pane, &QAbstractItemModel::rowsRemoved);
    const QSignalSpy inserted(&pane, &QAbstractItemModel::rowsInserted);
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", "1"}, {"C", "7"}, {"D", "4"}})));
    EXPECT_EQ(rows(pane), (Rows{"A=1", "C=7", "D=4"}));
    EXPECT_EQ(removed.count(), 1);
    EXPECT_EQ(inserted.count(), 0);
}

TEST_F(Pane, FollowsANodeThatTurnsFromALeafIntoABranchAndFromNoneIntoATree) {
    KelvoPaneController& pane = paneOf(NodeRef());
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", "1"}, {"B", "2"}})));
    EXPECT_EQ(rows(pane), (Rows{"A=1", "B=2"}));
    pane.reloadWithNode(treeOf(Dictionary::make({{"A", branch()}, {"B", "2"}})));
    EXPECT_EQ(rows(pane), (Rows{"A>", "B=2"}));
    pane.reloadWithNode(nullptr);
    EXPECT_EQ(rows(pane), Rows{});
}

TEST_F(Pane, GivesUpTheKeyboardWhenAnotherTakesItsPlace) {
    KelvoPaneController& pane = paneOf(Dictionary::make({{"Cells", branch()}}));
    const QSignalSpy resigned(&pane, &KelvoPaneController::resignFirstResponder);
    pane.didSelectRow(0);
    EXPECT_EQ(resigned.count(), 1);
}

TEST_F(Pane, ShowsTheToolbarWhenItIsAboutToBeSeen) {
    paneOf(branch());
    EXPECT_TRUE(stack->isToolbarHidden());
    stack->viewWillAppear();
    EXPECT_FALSE(stack->isToolbarHidden());
}

TEST_F(Pane, AtTheBottomIsNeverPopped) {
    KelvoPaneController& pane = paneOf(branch());
    EXPECT_FALSE(stack->popViewController());
    stack->popToViewController(pane, true);
    EXPECT_EQ(stack->viewControllers().size(), 1U);
}

}  // namespace
}  // namespace kelvo
