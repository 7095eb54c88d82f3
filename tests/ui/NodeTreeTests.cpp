// Tree operations: attaching, detaching, reordering, indices, identity and
// walks, including callbacks that tear the tree down while it is being walked.
#include <boost/numeric/conversion/cast.hpp>

#include <gtest/gtest.h>

#include "support/ui/NodeTestSupport.h"

namespace norvik::ui::test {
namespace {

std::vector<std::string> ChildNames(UI_Node& inParent) {
  std::vector<std::string> names;
  for (auto it = inParent.ChildBegin(); it != inParent.ChildEnd(); ++it) {
    names.push_back(tarsel::utility::ToStdString((*it)->UI_GetNodeID()));
  }
  return names;
}

void ExpectIndicesMatchPositions(UI_Node& inParent) {
  int i = 0;
  for (auto it = inParent.ChildBegin(); it != inParent.ChildEnd(); ++it, ++i) {
    EXPECT_EQ((*it)->UI_GetIndex(), i);
    EXPECT_EQ((*it)->UI_GetParentContainer(), &inParent);
  }
}

using NodeTree = ManagerTest;

TEST_F(NodeTree, PushBackAppendsAndInsertAtAPositionRenumbersTheChildrenAfterIt) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  MakeView(0, 0, 10, 10, root.get(), "a");
  MakeView(0, 0, 10, 10, root.get(), "c");
  EXPECT_EQ(ChildNames(*root), (std::vector<std::string>{"a", "c"}));
  ExpectIndicesMatchPositions(*root);
  auto b = MakeView(0, 0, 10, 10, nullptr, "b");
  root->ChildInsert(std::size_t(1), b);
  EXPECT_EQ(ChildNames(*root), (std::vector<std::string>{"a", "b", "c"}));
  ExpectIndicesMatchPositions(*root);
  auto z = MakeView(0, 0, 10, 10, nullptr, "z");
  root->ChildInsert(root->ChildEnd(), z);
  EXPECT_EQ(z->UI_GetIndex(), 3);
}

TEST_F(NodeTree, RemovingAChildDetachesItAndRenumbersTheRest) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto a = MakeView(0, 0, 10, 10, root.get(), "a");
  auto b = MakeView(0, 0, 10, 10, root.get(), "b");
  MakeView(0, 0, 10, 10, root.get(), "c");
  UI_NodeP removed = root->ChildRemove(a.get());
  EXPECT_EQ(removed, a);
  EXPECT_EQ(a->UI_GetIndex(), -1);
  EXPECT_EQ(a->UI_GetParentContainer(), nullptr);
  EXPECT_EQ(ChildNames(*root), (std::vector<std::string>{"b", "c"}));
  ExpectIndicesMatchPositions(*root);
  EXPECT_EQ(root->ChildRemove(a.get()), nullptr);
  EXPECT_FALSE(root->ChildRequestRemove(a.get()));
  EXPECT_TRUE(root->ChildRequestRemove(b.get()));
  EXPECT_EQ(b->UI_GetParentContainer(), nullptr);
}

TEST_F(NodeTree, MoveRotatesTheRangeBetweenTheTwoPositions) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  for (const char* n : {"a", "b", "c", "d", "e"}) MakeView(0, 0, 10, 10, root.get(), n);
  root->ChildMove(0, 3);
  EXPECT_EQ(ChildNames(*root), (std::vector<std::string>{"b", "c", "d", "a", "e"}));
  ExpectIndicesMatchPositions(*root);
  root->ChildMove(4, 1);
  EXPECT_EQ(ChildNames(*root), (std::vector<std::string>{"b", "e", "c", "d", "a"}));
  ExpectIndicesMatchPositions(*root);
  root->ChildSwapOrder(0, 4);
  EXPECT_EQ(ChildNames(*root), (std::vector<std::string>{"a", "e", "c", "d", "b"}));
  ExpectIndicesMatchPositions(*root);
}

TEST_F(NodeTree, OutOfRangeIndicesRaiseTheNumericCastErrorAndChangeNothing) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  MakeView(0, 0, 10, 10, root.get(), "a");
  MakeView(0, 0, 10, 10, root.get(), "b");
  EXPECT_THROW(root->ChildMove(0, 2), boost::numeric::bad_numeric_cast);
  EXPECT_THROW(root->ChildMove(std::size_t(-1), 0), boost::numeric::bad_numeric_cast);
  EXPECT_THROW(root->ChildSwapOrder(0, std::size_t(1) << 40), boost::numeric::bad_numeric_cast);
  EXPECT_THROW(root->ChildGet(2), boost::numeric::bad_numeric_cast);
  EXPECT_THROW(root->ChildInsert(std::size_t(3), MakeView(0, 0, 1, 1)), boost::numeric::bad_numeric_cast);
  EXPECT_EQ(ChildNames(*root), (std::vector<std::string>{"a", "b"}));
  EXPECT_EQ(root->ChildGet(1)->UI_GetNodeID(), UTF8String("b"));
}

TEST_F(NodeTree, StructuralChangesEmptyTheTabOrderCacheAndInvalidateTheParent) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  root->invalidations.clear();
  auto a = MakeView(0, 0, 10, 10, root.get(), "a");
  EXPECT_FALSE(root->invalidations.empty());
  root->invalidations.clear();
  MakeView(0, 0, 10, 10, root.get(), "b");
  root->ChildSwapOrder(0, 1);
  EXPECT_FALSE(root->invalidations.empty());
  EXPECT_TRUE(root->GetTabOrderCache().empty());
}

TEST_F(NodeTree, DeleteChildrenDetachesEveryChild) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto a = MakeView(0, 0, 10, 10, root.get(), "a");
  auto b = MakeView(0, 0, 10, 10, root.get(), "b");
  root->DeleteChildren();
  EXPECT_EQ(root->ChildSize(), 0u);
  EXPECT_EQ(a->UI_GetParentContainer(), nullptr);
  EXPECT_EQ(b->UI_GetIndex(), -1);
}

TEST_F(NodeTree, ChildrenOutliveTheirDestroyedParentAsDetachedNodes) {
  RecordingViewP child;
  {
    auto root = MakeView(0, 0, 100, 100, nullptr, "root");
    child = MakeView(0, 0, 10, 10, root.get(), "child");
  }
  EXPECT_EQ(child->UI_GetParentContainer(), nullptr);
  EXPECT_EQ(child->UI_GetIndex(), -1);
}

TEST_F(NodeTree, ParentWalksRunRootFirstAndStopAtTheRoot) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto mid = MakeView(0, 0, 50, 50, root.get(), "mid");
  auto leaf = MakeView(0, 0, 10, 10, mid.get(), "leaf");
  EXPECT_EQ(leaf->UI_GetRootNode(), root.get());
  EXPECT_EQ(leaf->UI_GetRootContainer(), static_cast<UI_Container*>(root.get()));
  EXPECT_EQ(leaf->UI_GetNodeParents(), (std::vector<UI_Node*>{root.get(), mid.get(), leaf.get()}));
  EXPECT_TRUE(leaf->UI_IsChildOf(*root));
  EXPECT_FALSE(leaf->UI_IsChildOf(*leaf));
  EXPECT_FALSE(root->UI_IsChildOf(*leaf));
  EXPECT_TRUE(root->UI_IsChild(leaf));
  EXPECT_FALSE(root->UI_IsChild(nullptr));
  EXPECT_EQ(leaf->UI_GetParentEventRecipientNode(), nullptr);
}

TEST_F(NodeTree, APlainContainerIsNotANodeAndEndsUpwardWalks) {
  UI_Container plain;
  auto top = MakeView(0, 0, 10, 10, nullptr, "top");
  plain.ChildPushBack(top);
  auto leaf = MakeView(0, 0, 5, 5, top.get(), "leaf");
  EXPECT_FALSE(plain.IsANode());
  EXPECT_EQ(plain.GetAsANode(), nullptr);
  EXPECT_TRUE(top->IsANode());
  EXPECT_EQ(top->UI_GetParentNode(), nullptr);
  EXPECT_EQ(leaf->UI_GetRootNode(), top.get());
  EXPECT_EQ(leaf->UI_GetRootContainer(), &plain);
  plain.DeleteChildren();
}

TEST_F(NodeTree, ChildLookupByIDFindsTheFirstDirectChildOnly) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto first = MakeView(0, 0, 10, 10, root.get(), "x");
  MakeView(0, 0, 10, 10, root.get(), "x");
  auto holder = MakeView(0, 0, 10, 10, root.get(), "holder");
  MakeView(0, 0, 10, 10, holder.get(), "deep");
  EXPECT_EQ(root->UI_ChildGetFromID("x"), first.get());
  EXPECT_EQ(root->UI_ChildGetFromID("deep"), nullptr);
  EXPECT_EQ(root->UI_ChildFindFromID("nothing"), root->ChildEnd());
}

TEST_F(NodeTree, ReparentingIsAnnouncedToTheWholeMovedSubtree) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto mid = MakeView(0, 0, 50, 50, nullptr, "mid");
  auto leaf = MakeView(0, 0, 10, 10, mid.get(), "leaf");
  leaf->nodeChanges.clear();
  root->ChildPushBack(mid);
  ASSERT_FALSE(leaf->nodeChanges.empty());
  EXPECT_EQ(leaf->nodeChanges.back(), UI_Node::kNodeChangeParent);
}

TEST_F(NodeTree, ANodeChangeHandlerThatRemovesItsOwnNodeDoesNotCrash) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto mid = MakeView(0, 0, 50, 50, nullptr, "mid");
  auto a = MakeView(0, 0, 10, 10, mid.get(), "a");
  auto b = MakeView(0, 0, 10, 10, mid.get(), "b");
  UI_Node* midRaw = mid.get();
  a->onNodeChanged = [midRaw](UI_Node::NodeChange) {
    // Tear down the parent's children while the announcement walks them.
    midRaw->DeleteChildren();
  };
  b->onNodeChanged = [](UI_Node::NodeChange) {};
  a.reset();  // only the tree holds a now
  root->ChildPushBack(mid);
  EXPECT_EQ(mid->ChildSize(), 0u);
  EXPECT_EQ(b->UI_GetParentContainer(), nullptr);
}

TEST_F(NodeTree, AHandlerThatDeletesTheParentDuringDisablingDoesNotCrash) {
  auto root = MakeView(0, 0, 100, 100, nullptr, "root");
  auto mid = MakeView(0, 0, 50, 50, root.get(), "mid");
  auto leaf = MakeView(0, 0, 10, 10, mid.get(), "leaf");
  UI_Node* rootRaw = root.get();
  UI_Node* midRaw = mid.get();
  int calls = 0;
  leaf->InstallDisabledChangedFunction(boost::make_shared<boost::function<void()>>([&] {
    ++calls;
    rootRaw->ChildRemove(midRaw);
  }));
  mid.reset();
  leaf.reset();
  root->UI_SetDisabled(true);
  // Once for the inherited disable, once more when the removal detached it again.
  EXPECT_EQ(calls, 2);
  EXPECT_EQ(root->ChildSize(), 0u);
}

}  // namespace
}  // namespace norvik::ui::test
