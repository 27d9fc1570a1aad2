#include <gtest/gtest.h>
#include <sys/resource.h>

#include <thread>

#include "LogGenerator/ArrayLock.h"
#include "model/KelvoModelNode.h"

namespace kelvo {
namespace {

/// "name=value" of a leaf, "name[child,child]" of an inner node.
std::string outline(const KelvoModelNode& node) {
    if (node.value() != nullptr) return node.displayName() + "=" + *node.value();
    std::string text = node.displayName() + "[";
    for (const NodeRef& child : *node.childNodes()) {
        if (!text.ends_with('[')) text += ',';
        text += outline(*child);
    }
    return text + "]";
}

class DisplayTree : public testing::Test {
protected:
    std::string treeOf(const Value& object) {
        nodes.clear();
        return outline(*KelvoModelNode::makeTreeFromObject(object, nodes));
    }
    std::string at(const std::string& path) {
        const NodeRef node = nodes.find(path);
        return node ? outline(*node) : "(no node)";
    }

    NodesByPath nodes;
};

TEST_F(DisplayTree, ShowsAStringAsALeafAndADictionaryInItsOwnOrder) {
    EXPECT_EQ(treeOf(Dictionary::make({{"b", "1"}, {"a", Dictionary::make({{"RSCP", "-90"}})}, {"c", ""}})),
              "Kelvo[b=1,a[RSCP=-90],c=]");
    EXPECT_EQ(treeOf("text"), "Kelvo=text");
    EXPECT_EQ(treeOf(Dictionary::make()), "Kelvo[]");
    EXPECT_EQ(treeOf(Array::make()), "Kelvo[]");
}

TEST_F(DisplayTree, GivesALeafNoChildrenAndAnInnerNodeNoValue) {
    treeOf(Dictionary::make({{"a", "1"}}));
    EXPECT_EQ(nodes.find("/")->value(), nullptr);
    EXPECT_EQ(nodes.find("/a")->childNodes(), nullptr);
}

TEST_F(DisplayTree, ShowsWhatIsNeitherTextNorContainerAsUnknown) {
    EXPECT_EQ(treeOf(Value()), "Kelvo=(unknown)");
    EXPECT_EQ(at("/"), "Kelvo=(unknown)");
    EXPECT_EQ(treeOf(Array::make({Value(5), Value(true), Value(Bytes{1}), Value(Date{}), Value()})),
              "Kelvo[0=(unknown),1=(unknown),2=(unknown),3=(unknown),4=(unknown)]");
}

TEST_F(DisplayTree, SkipsAKeyWithoutAValue) {
    EXPECT_EQ(treeOf(Dictionary::make({{"a", Value()}, {"b", "1"}})), "Kelvo[b=1]");
    EXPECT_EQ(at("/a"), "(no node)");
}

TEST_F(DisplayTree, OrdersASortedDictionaryByItsWholeKeysAndShowsThePartBehindTheSemicolon) {
    EXPECT_EQ(treeOf(Dictionary::make({{"b;X", "1"}, {"_sorted", ""}, {"a;Y", "2"}})), "Kelvo[Y=2,X=1]");
    EXPECT_EQ(treeOf(Dictionary::make({{"_sorted", false}, {"10;A", "1"}, {"9;B", "2"}, {"02;RSCP", "3"}})),
              "Kelvo[RSCP=3,A=1,B=2]");
    EXPECT_EQ(treeOf(Dictionary::make({{"_sorted", ""}, {"b", "1"}, {"B", "2"}, {"\xC3\xA4", "3"}, {"aa", "4"}})),
              "Kelvo[B=2,aa=4,b=1,\xC3\xA4=3]");
}

TEST_F(DisplayTree, SplitsASortedKeyOnlyIntoExactlyTwoParts) {
    EXPECT_EQ(treeOf(Dictionary::make({{"_sorted", ""}, {"a;b;c", "1"}, {"plain", "2"}, {";lead", "3"}})),
              "Kelvo[lead=3,a;b;c=1,plain=2]");
}

TEST_F(DisplayTree, KeepsTheSemicolonOfAnUnsortedKey) {
    EXPECT_EQ(treeOf(Dictionary::make({{"b;X", "1"}, {"a;Y", "2"}})), "Kelvo[b;X=1,a;Y=2]");
    EXPECT_EQ(at("/b;X"), "b;X=1");
}

TEST_F(DisplayTree, SortsOnlyTheLevelThatAsksForIt) {
    EXPECT_EQ(treeOf(Dictionary::make({{"_sorted", ""}, {"2;in", Dictionary::make({{"z;1", "a"}, {"y;2", "b"}})}})),
              "Kelvo[in[z;1=a,y;2=b]]");
}

TEST_F(DisplayTree, NumbersTheElementsOfAnArray) {
    EXPECT_EQ(treeOf(Array::make({"x", Array::make({"y"}), Dictionary::make({{"k", "v"}})})),
              "Kelvo[0=x,1[0=y],2[k=v]]");
    EXPECT_EQ(at("/1/0"), "0=y");
    EXPECT_EQ(at("/2/k"), "k=v");
}

TEST_F(DisplayTree, FindsEveryNodeUnderItsPath) {
    treeOf(Dictionary::make({{"Serving Cell", Dictionary::make({{"_sorted", ""}, {"02;RSCP", "-90"}})},
                             {"Active Set", Array::make({Dictionary::make({{"PSC", "7"}})})}}));
    EXPECT_EQ(at("/Serving"), "(no node)");
    EXPECT_EQ(at("/Serving Cell/"), "(no node)");
    EXPECT_EQ(at("Serving Cell"), "(no node)");
    EXPECT_EQ(at(""), "(no node)");
    EXPECT_EQ(at("/"), "Kelvo[Serving Cell[RSCP=-90],Active Set[0[PSC=7]]]");
    EXPECT_EQ(at("/Serving Cell"), "Serving Cell[RSCP=-90]");
    EXPECT_EQ(at("/Serving Cell/RSCP"), "RSCP=-90");
    EXPECT_EQ(at("/Active Set"), "Active Set[0[PSC=7]]");
    EXPECT_EQ(at("/Active Set/0"), "0[PSC=7]");
    EXPECT_EQ(at("/Active Set/0/PSC"), "PSC=7");
}

TEST_F(DisplayTree, KeepsTheLaterOfTwoNodesWithOnePath) {
    EXPECT_EQ(treeOf(Dictionary::make({{"_sorted", ""}, {"2;X", "second"}, {"1;X", "first"}})),
              "Kelvo[X=first,X=second]");
    EXPECT_EQ(at("/X"), "X=second");
}

TEST_F(DisplayTree, StoresAParentAfterAChildThatSharesItsPath) {
    treeOf(Dictionary::make({{"_sorted", ""}, {"01;", "nameless"}, {"02;A", "1"}}));
    EXPECT_EQ(at("/"), "Kelvo[=nameless,A=1]");
}

TEST_F(DisplayTree, ShowsAKeyWithASlashUnderOneNameAndALongerPath) {
    EXPECT_EQ(treeOf(Dictionary::make({{"Ec/Io", "-7"}})), "Kelvo[Ec/Io=-7]");
    EXPECT_EQ(at("/Ec/Io"), "Ec/Io=-7");
}

TEST_F(DisplayTree, KeepsItsTextsWhenTheDisplayChanges) {
    const DictionaryRef display = Dictionary::make({{"a", "before"}});
    treeOf(display);
    display->set("a", "after");
    EXPECT_EQ(at("/a"), "a=before");
}

TEST_F(DisplayTree, ReplacesWhatThePathsHeldBefore) {
    treeOf(Dictionary::make({{"a", "1"}}));
    KelvoModelNode::makeTreeFromObject(Dictionary::make({{"a", "2"}}), nodes);
    EXPECT_EQ(at("/a"), "a=2");
}

/// Kept for every node, the paths of this display would take 180 megabytes.
TEST_F(DisplayTree, FindsNodesBelowLongNamesWithoutKeepingTheirPaths) {
    const DictionaryRef leaves = Dictionary::make();
    for (int i = 0; i < 3000; ++i) leaves->set(std::to_string(i), "v" + std::to_string(i));
    Value display = leaves;
    std::string path;
    for (int i = 0; i < 60; ++i) {
        const std::string name(1000, static_cast<char>('A' + i));
        display = Dictionary::make({{name, display}});
        path.insert(0, "/" + name);
    }
    struct rusage before {};
    struct rusage after {};
    ::getrusage(RUSAGE_SELF, &before);
    KelvoModelNode::makeTreeFromObject(display, nodes);
    ::getrusage(RUSAGE_SELF, &after);
    EXPECT_LT(after.ru_maxrss - before.ru_maxrss, 64 * 1024);  // in KiB
    EXPECT_EQ(at(path + "/2999"), "2999=v2999");
}

TEST(DisplayPath, SeparatesComponentsByOneSlash) {
    EXPECT_EQ(pathByAppending("/", "A"), "/A");
    EXPECT_EQ(pathByAppending("/A", "B"), "/A/B");
    EXPECT_EQ(pathByAppending("/A/", "B"), "/A/B");
    EXPECT_EQ(pathByAppending("/A", "/B"), "/A/B");
    EXPECT_EQ(pathByAppending("/A", ""), "/A");
    EXPECT_EQ(pathByAppending("/", ""), "/");
}

/// `levels` containers inside one another, the innermost holding "end"; taken apart level by level when it goes.
class Nest {
public:
    Nest(int levels, bool arrays) {
        Value inside = "end";
        for (int i = 0; i < levels; ++i) {
            inside = arrays ? Value(Array::make({inside})) : Value(Dictionary::make({{"0", inside}}));
            _levels.push_back(inside);
        }
    }
    ~Nest() {
        while (!_levels.empty()) _levels.pop_back();  // from the outside inwards: each frees one level
    }
    Nest(const Nest&) = delete;
    Nest& operator=(const Nest&) = delete;
    const Value& outermost() const { return _levels.back(); }

private:
    std::vector<Value> _levels;
};

std::string innermostValue(const NodeRef& root, int& levels) {
    const KelvoModelNode* node = root.get();
    for (levels = 0; node->childNodes() != nullptr; ++levels) node = node->childNodes()->front().get();
    return *node->value();
}

class DeepDisplay : public testing::TestWithParam<bool> {};

TEST_P(DeepDisplay, IsShownWholeAsFarAsPropertyListsReach) {
    const Nest nest(512, GetParam());
    NodesByPath nodes;
    int levels = 0;
    EXPECT_EQ(innermostValue(KelvoModelNode::makeTreeFromObject(nest.outermost(), nodes), levels), "end");
    EXPECT_EQ(levels, 512);
}

TEST_P(DeepDisplay, EndsInAnUnknownLeafBeyond) {
    const Nest nest(10000, GetParam());
    NodesByPath nodes;
    int levels = 0;
    EXPECT_EQ(innermostValue(KelvoModelNode::makeTreeFromObject(nest.outermost(), nodes), levels), "(unknown)");
    EXPECT_EQ(levels, 512);
}

TEST_P(DeepDisplay, LeavesTheArrayLockFree) {
    const Nest nest(300, GetParam());
    NodesByPath nodes;
    KelvoModelNode::makeTreeFromObject(nest.outermost(), nodes);
    std::thread([] { const ArrayLock::Held held; }).join();  // hangs while this thread still holds it
}

// Held 256 times, the lock stands at a depth of 0: one more take and its release, those of the walk, free it.
TEST(DisplayTreeWalk, TakesTheArrayLockForAnArray) {
    for (int i = 0; i < 256; ++i) ArrayLock::lockArray();
    NodesByPath nodes;
    KelvoModelNode::makeTreeFromObject(Array::make({"row"}), nodes);
    std::thread([] { const ArrayLock::Held held; }).join();  // hangs when the walk took no lock
    for (int i = 0; i < 256; ++i) ArrayLock::unlockArray();
}

INSTANTIATE_TEST_SUITE_P(Kinds, DeepDisplay, testing::Bool(),
                         [](const auto& info) { return info.param ? "Arrays" : "Dictionaries"; });

}  // namespace
}  // namespace kelvo
