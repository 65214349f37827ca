#include "Orn_Hdl/Attributes.h"

#include "Orn_Hdl/Model.h"
#include "Support/Names.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <climits>
#include <cmath>
#include <cstdio>
#include <locale>
#include <memory>
#include <string>
#include <vector>

namespace {

using namespace Orn_Hdl;
using Support::Names;
using Support::NamesOf;

std::unique_ptr<Attribute> Create(const char* type, const char* name, const char* value) {
    const AttributeFactory::Creator creator = AttributeFactory::GetCreators().Get(type);
    return std::unique_ptr<Attribute>(creator == nullptr ? nullptr : creator(name, value));
}

TEST(AttributeFactory, MakesTheSevenTypesInAnyCase) {
    const char* const types[] = {"String", "Integer",   "Float", "Boolean",
                                 "Bit",    "BitVector", "User"};
    for (int i = 0; i < 7; ++i) {
        const std::unique_ptr<Attribute> attribute = Create(types[i], "NAME[1]", "1");
        ASSERT_NE(attribute, nullptr) << types[i];
        EXPECT_EQ(attribute->GetValueType(), i);
        EXPECT_EQ(attribute->GetValueTypeName(), types[i]);
        EXPECT_EQ(attribute->GetName(), "NAME(1)");
        EXPECT_EQ(attribute->GetObjectType(), 100);
    }
    EXPECT_NE(Create("bitvector", "a", "1"), nullptr);
    for (const char* type : {"", "Text", "Bit Vector", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(Create(type, "a", "1"), nullptr);
    }
    EXPECT_STREQ(Attribute::DEFAULT_ATTRTYPE, "String");
    EXPECT_EQ(Attribute::DEFAULT_GENERIC, 0);
    EXPECT_EQ(Attribute::DEFAULT_SYNATTR, 0);
}

TEST(AttributeFactory, MakesTheClassOfEachType) {
    EXPECT_NE(dynamic_cast<AttributeString*>(Create("String", "a", "").get()), nullptr);
    EXPECT_NE(dynamic_cast<AttributeInteger*>(Create("Integer", "a", "").get()), nullptr);
    EXPECT_NE(dynamic_cast<AttributeFloat*>(Create("Float", "a", "").get()), nullptr);
    EXPECT_NE(dynamic_cast<AttributeBoolean*>(Create("Boolean", "a", "").get()), nullptr);
    EXPECT_NE(dynamic_cast<AttributeBit*>(Create("Bit", "a", "").get()), nullptr);
    EXPECT_NE(dynamic_cast<AttributeBitVector*>(Create("BitVector", "a", "").get()), nullptr);
    EXPECT_NE(dynamic_cast<AttributeUser*>(Create("User", "a", "").get()), nullptr);
}

TEST(Attribute, ReadsNullsAsEmptyTexts) {
    for (const char* type : {"String", "Integer", "Float", "Boolean", "Bit", "BitVector", "User"}) {
        const std::unique_ptr<Attribute> attribute = Create(type, nullptr, nullptr);
        EXPECT_EQ(attribute->GetName(), "");
        EXPECT_EQ(attribute->GetValueString(), Create(type, "", "")->GetValueString()) << type;
        attribute->SetValue(nullptr);
    }
}

TEST(AttributeString, IsItsText) {
    AttributeString attribute("a", "some text");
    EXPECT_EQ(attribute.GetValue(), "some text");
    attribute.SetValue(" [x] \n");
    EXPECT_EQ(attribute.GetValueString(), " [x] \n");
    attribute.SetValue(nullptr);
    EXPECT_EQ(attribute.GetValue(), "");
}

TEST(AttributeInteger, FollowsTheRulesOfAtoiAndSaturates) {
    const std::vector<std::pair<const char*, int>> cases{{"12abc", 12},
                                                         {"abc", 0},
                                                         {"", 0},
                                                         {" \t-7", -7},
                                                         {"+5", 5},
                                                         {"- 5", 0},
                                                         {"--5", 0},
                                                         {"0x10", 0},
                                                         {"2147483648", INT_MAX},
                                                         {"-99999999999999999999", INT_MIN}};
    for (const auto& [text, value] : cases) {
        const AttributeInteger attribute("a", text);
        EXPECT_EQ(attribute.GetValue(), value) << text;
        EXPECT_EQ(attribute.GetValueString(), std::to_string(value).c_str()) << text;
    }
}

TEST(AttributeFloat, IsWrittenWithTheDecimalsOfItsText) {
    const std::vector<std::pair<const char*, const char*>> cases{
        {"3.14159", "3.14159"}, {"2", "2.0"},       {"5", "5.0"},     {"12.345", "12.345"},
        {".5", "0.5"},          {"", "0.0"},        {"0.50", "0.50"}, {"-1.5", "-1.5"},
        {"+1.5", " 1.5"},       {"007.5", "  7.5"}, {"1.2.3", "1.2"}, {"5.", "5.0"},
        {"1.5e2", "150.000"},   {"1e3", "1000.0"},  {"abc", "  0.0"}, {".", "0.0"},
        {"..5", "0.0"},         {"9.99x", "9.990"}, {"inf", "  0.0"}, {"1e999", "    0.0"},
        {"-.25", "-0.25"}};
    for (const auto& [text, written] : cases) {
        EXPECT_EQ(AttributeFloat("a", text).GetValueString(), written) << "from " << text;
    }
}

TEST(AttributeFloat, ForgetsTheDecimalsOfItsFormerText) {
    AttributeFloat attribute("a", "3.14159");
    EXPECT_EQ(attribute.GetValue(), 3.14159);
    attribute.SetValue("2");
    EXPECT_EQ(attribute.GetValueString(), "2.0");
    attribute.SetValue("1.25");
    attribute.SetValue(nullptr);
    EXPECT_EQ(attribute.GetValueString(), "0.0");
}

TEST(AttributeFloat, ConsultsNoLocale) {
    struct Comma : std::numpunct<char> {
        char do_decimal_point() const override { return ','; }
        char do_thousands_sep() const override { return '.'; }
        std::string do_grouping() const override { return "\3"; }
    };
    const std::locale former = std::locale::global(std::locale(std::locale(), new Comma));
    const std::string written = Support::Text(AttributeFloat("a", "12345.5").GetValueString());
    std::locale::global(former);
    EXPECT_EQ(written, "12345.5");
}

TEST(AttributeFloat, TakesHugeTexts) {
    const std::string manyDecimals = "1." + std::string(100000, '3');
    EXPECT_EQ(AttributeFloat("a", manyDecimals.c_str()).GetValueString().GetLength(), 100002u);
    const std::string manyDigits(300, '9');
    EXPECT_EQ(AttributeFloat("a", manyDigits.c_str()).GetValueString().GetLength(), 303u);
    const std::string wide = std::string(100000, '0') + "1.5";
    EXPECT_EQ(AttributeFloat("a", wide.c_str()).GetValueString().GetLength(), 100003u);
}

RC_GTEST_PROP(AttributeFloat, IsWrittenAsPrintfWritesIt, (int whole, unsigned decimals)) {
    const std::string left = std::to_string(whole);
    const std::string right = std::to_string(decimals);
    const std::string text = left + "." + right;
    char expected[100];
    std::snprintf(expected, sizeof expected, "%*.*f",
                  static_cast<int>(left.size() + right.size() + 1), static_cast<int>(right.size()),
                  std::atof(text.c_str()));
    RC_ASSERT(AttributeFloat("a", text.c_str()).GetValueString() == expected);
}

TEST(AttributeBoolean, IsTrueForTheTextTrueOnly) {
    for (const char* text : {"TRUE", "true", "True"}) {
        EXPECT_TRUE(AttributeBoolean("a", text).GetValue()) << text;
        EXPECT_EQ(AttributeBoolean("a", text).GetValueString(), "TRUE");
    }
    for (const char* text : {"yes", "1", "", " true", "true ", "tru", "false"}) {
        EXPECT_FALSE(AttributeBoolean("a", text).GetValue()) << text;
        EXPECT_EQ(AttributeBoolean("a", text).GetValueString(), "FALSE");
    }
}

TEST(AttributeBit, IsOneForTheTextOneOnly) {
    EXPECT_EQ(AttributeBit("a", "1").GetValue(), "1");
    EXPECT_EQ(AttributeBit("a", "1").GetValueString(), "1");
    for (const char* text : {"0", "", "11", "01", " 1", "true", "H"}) {
        EXPECT_EQ(AttributeBit("a", text).GetValueString(), "0") << text;
    }
}

TEST(AttributeBitVector, IsWrittenAsItsDigitsAlone) {
    AttributeBitVector attribute("a", "8:H:A5");
    EXPECT_EQ(attribute.GetValue(), "A5");
    EXPECT_EQ(attribute.GetValueString(), "A5");
    EXPECT_EQ(attribute.GetBitVectorValue().GetLength(), 8);
    EXPECT_EQ(attribute.GetBitVectorValue().GetBase(), 16);
    attribute.SetValue("1010");
    EXPECT_EQ(attribute.GetValueString(), "1010");
    EXPECT_FALSE(attribute.GetBitVectorValue().HasBaseAndLength());
}

TEST(AttributeUser, HasATypeOfItsOwn) {
    AttributeUser attribute("a", "value");
    EXPECT_EQ(attribute.GetUserType(), "");
    attribute.SetUserType("state_type");
    attribute.SetValue("idle");
    EXPECT_EQ(attribute.GetValue(), "idle");
    EXPECT_EQ(attribute.GetValueString(), "idle");
    EXPECT_EQ(attribute.GetUserType(), "state_type");
    attribute.SetUserType(nullptr);
    EXPECT_EQ(attribute.GetUserType(), "");
}

TEST(AttributeOptions, StartAsNone) {
    const AttributeString attribute("a", "");
    EXPECT_EQ(attribute.GetGenericOption(), 0);
    EXPECT_EQ(attribute.GetGeneric(), "NONE");
    EXPECT_EQ(attribute.GetSynAttrOption(), 0);
    EXPECT_EQ(attribute.GetSynAttr(), "NONE");
}

TEST(AttributeOptions, GenericTakesItsThreeTextsInAnyCase) {
    AttributeString attribute("a", "");
    EXPECT_TRUE(attribute.SetGeneric("syn"));
    EXPECT_EQ(attribute.GetGenericOption(), 2);
    EXPECT_EQ(attribute.GetGeneric(), "SYN");
    EXPECT_TRUE(attribute.SetGeneric("NoSyn"));
    EXPECT_EQ(attribute.GetGenericOption(), 1);
    EXPECT_EQ(attribute.GetGeneric(), "NOSYN");
    for (const char* text :
         {"", "YES", "SY", "SYNN", "ASSIGN", static_cast<const char*>(nullptr)}) {
        EXPECT_FALSE(attribute.SetGeneric(text));
        EXPECT_EQ(attribute.GetGeneric(), "NOSYN");
    }
    EXPECT_TRUE(attribute.SetGeneric("none"));
    EXPECT_EQ(attribute.GetGenericOption(), 0);
    EXPECT_EQ(attribute.GetSynAttrOption(), 0);
}

TEST(AttributeOptions, SynAttrTakesItsThreeTextsInAnyCase) {
    AttributeString attribute("a", "");
    EXPECT_TRUE(attribute.SetSynAttr("assign"));
    EXPECT_EQ(attribute.GetSynAttrOption(), 1);
    EXPECT_EQ(attribute.GetSynAttr(), "ASSIGN");
    EXPECT_TRUE(attribute.SetSynAttr("AssignNoDec"));
    EXPECT_EQ(attribute.GetSynAttrOption(), 2);
    EXPECT_EQ(attribute.GetSynAttr(), "ASSIGNNODEC");
    for (const char* text :
         {"ASSIGN_NODEC", "", "ASSIG", "SYN", static_cast<const char*>(nullptr)}) {
        EXPECT_FALSE(attribute.SetSynAttr(text));
        EXPECT_EQ(attribute.GetSynAttr(), "ASSIGNNODEC");
    }
    EXPECT_TRUE(attribute.SetSynAttr("NONE"));
    EXPECT_EQ(attribute.GetSynAttrOption(), 0);
    EXPECT_EQ(attribute.GetGenericOption(), 0);
}

TEST(Attribute, ClonesHaveEverything) {
    for (const char* type : {"String", "Integer", "Float", "Boolean", "Bit", "BitVector", "User"}) {
        std::unique_ptr<Attribute> original = Create(type, "NAME", "1");
        original->SetGeneric("NOSYN");
        original->SetSynAttr("ASSIGNNODEC");
        original->AddComment("comment");
        const std::unique_ptr<Attribute> clone(original->CloneAttribute());
        EXPECT_TRUE(*clone == *original) << type;
        EXPECT_EQ(clone->GetValueType(), original->GetValueType());
        EXPECT_EQ(clone->GetValueString(), original->GetValueString());
        EXPECT_EQ(clone->GetGeneric(), "NOSYN");
        EXPECT_EQ(clone->GetSynAttr(), "ASSIGNNODEC");
        original.reset();
        EXPECT_EQ(clone->GetName(), "NAME");
    }
}

TEST(Attribute, ClonesKeepWhatTheirClassAdds) {
    AttributeUser user("a", "v");
    user.SetUserType("type");
    const std::unique_ptr<Attribute> userClone(user.CloneAttribute());
    EXPECT_EQ(dynamic_cast<AttributeUser&>(*userClone).GetUserType(), "type");
    const AttributeFloat number("a", "1.250");
    const std::unique_ptr<Attribute> numberClone(number.CloneAttribute());
    EXPECT_EQ(numberClone->GetValueString(), "1.250");
    const AttributeBitVector bits("a", "8:H:A5");
    const std::unique_ptr<Attribute> bitsClone(bits.CloneAttribute());
    EXPECT_EQ(dynamic_cast<AttributeBitVector&>(*bitsClone).GetBitVectorValue().GetLength(), 8);
}

TEST(Attribute, CopiesAndAssignmentsTakeEverything) {
    AttributeString original("a", "v");
    original.SetGeneric("SYN");
    original.AddComment("c");
    const AttributeString copy(original);
    EXPECT_TRUE(copy == original);
    AttributeString assigned("b", "w");
    assigned.SetSynAttr("ASSIGN");
    assigned = original;
    EXPECT_TRUE(assigned == original);
    EXPECT_EQ(assigned.GetSynAttr(), "NONE");
    AttributeString& same = assigned;
    assigned = same;
    EXPECT_TRUE(assigned == original);
}

TEST(Attribute, IsEqualWhenNameCommentOptionsAndValueTextAre) {
    const AttributeString a("a", "Value");
    EXPECT_TRUE(a == AttributeString("a", "vALUE")) << "values compare ignoring case";
    EXPECT_TRUE(a != AttributeString("A", "Value")) << "names do not";
    EXPECT_TRUE(a != AttributeString("a", "other"));
    AttributeString b("a", "Value");
    b.SetGeneric("SYN");
    EXPECT_TRUE(a != b);
    b.SetGeneric("NONE");
    b.SetSynAttr("ASSIGN");
    EXPECT_TRUE(a != b);
    b.SetSynAttr("NONE");
    EXPECT_TRUE(a == b);
    b.AddComment("c");
    EXPECT_TRUE(a != b);
}

class Recorder : public AttributeVisitor {
public:
    void VisitAttribute(Attribute*) override { calls.push_back("any"); }
    void VisitAttributeString(AttributeString*) override { calls.push_back("String"); }
    void VisitAttributeInteger(AttributeInteger*) override { calls.push_back("Integer"); }
    void VisitAttributeFloat(AttributeFloat*) override { calls.push_back("Float"); }
    void VisitAttributeBit(AttributeBit*) override { calls.push_back("Bit"); }
    void VisitAttributeBitVector(AttributeBitVector*) override { calls.push_back("BitVector"); }
    void VisitAttributeBoolean(AttributeBoolean*) override { calls.push_back("Boolean"); }
    void VisitAttributeUser(AttributeUser*) override { calls.push_back("User"); }

    std::vector<std::string> calls;
};

TEST(AttributeVisitor, MeetsEachAttributeOnceByItsType) {
    for (const char* type : {"String", "Integer", "Float", "Boolean", "Bit", "BitVector", "User"}) {
        Recorder recorder;
        Create(type, "a", "1")->AcceptAttribute(recorder);
        EXPECT_EQ(recorder.calls, std::vector<std::string>{type});
    }
}

/// An attribute of a client that does not know its own visit operation.
class Foreign : public Attribute {
public:
    Foreign() : Attribute("foreign") {}
    Attribute* CloneAttribute() const override { return new Foreign; }
    void SetValue(const char*) override {}
    Port::String GetValueString() const override { return "value"; }
    ValueType GetValueType() const override { return User; }
};

TEST(AttributeVisitor, MeetsAnyOtherAttributeThroughTheGeneralOperation) {
    Recorder recorder;
    Foreign foreign;
    foreign.AcceptAttribute(recorder);
    EXPECT_EQ(recorder.calls, std::vector<std::string>{"any"});
}

TEST(AttributeVisitor, OfTheBaseChangesNothing) {
    AttributeVisitor visitor;
    const AttributeVisitor copy(visitor);
    visitor = copy;
    AttributeString attribute("a", "b");
    attribute.AcceptAttribute(visitor);
    Foreign().AcceptAttribute(visitor);
    EXPECT_EQ(attribute.GetName(), "a");
    EXPECT_EQ(attribute.GetValueString(), "b");
}

TEST(AttributeFloat, KeepsTheSignOfWhatIsTooSmall) {
    EXPECT_EQ(AttributeFloat("a", "-1e-400").GetValueString(), "     -0.0");
    EXPECT_TRUE(std::signbit(AttributeFloat("a", "-1e-400").GetValue()));
    EXPECT_EQ(AttributeFloat("a", "1e-400").GetValueString(), "     0.0");
    EXPECT_EQ(AttributeFloat("a", "-1e400").GetValueString(), "     0.0");
}

TEST(AttributeHolder, StartsEmpty) {
    const AttributeHolder holder;
    EXPECT_FALSE(holder.HasAttrs());
    EXPECT_EQ(holder.GetAttr("a"), nullptr);
    EXPECT_EQ(holder.GetAttr(nullptr), nullptr);
    EXPECT_TRUE(holder.GetAttrIterator().IsAtEnd());
}

TEST(AttributeHolder, KeepsTheOrderOfAddition) {
    AttributeHolder holder;
    for (const char* name : {"b", "a", "c"}) {
        holder.AddAttr(new AttributeString(name, ""));
    }
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), (Names{"b", "a", "c"}));
    EXPECT_TRUE(holder.HasAttrs());
}

TEST(AttributeHolder, FindsByNormalisedNameIgnoringCase) {
    AttributeHolder holder;
    Attribute* attribute = new AttributeString("Loc[3]", "x");
    holder.AddAttr(attribute);
    EXPECT_EQ(holder.GetAttr("LOC(3)"), attribute);
    EXPECT_EQ(holder.GetAttr("loc<3>"), attribute);
    EXPECT_EQ(holder.GetAttr("loc"), nullptr);
}

TEST(AttributeHolder, OfTwoAttributesOfOneNameFindsTheSecondAndYieldsBoth) {
    AttributeHolder holder;
    Attribute* first = new AttributeString("LOC", "1");
    Attribute* second = new AttributeString("loc", "2");
    holder.AddAttr(first);
    holder.AddAttr(second);
    EXPECT_EQ(holder.GetAttr("LOC"), second);
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), (Names{"LOC", "loc"}));
}

TEST(AttributeHolder, IgnoresNullAndWhatHasAnOwner) {
    AttributeHolder holder;
    AttributeHolder other;
    holder.AddAttr(nullptr);
    EXPECT_FALSE(holder.HasAttrs());
    Attribute* attribute = new AttributeString("a", "1");
    holder.AddAttr(attribute);
    holder.AddAttr(attribute);
    other.AddAttr(attribute);
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), Names{"a"});
    EXPECT_TRUE(other.GetAttrIterator().IsAtEnd());
    EXPECT_EQ(other.GetAttr("a"), nullptr);
}

TEST(AttributeHolder, CopiesCloneEveryAttribute) {
    AttributeHolder holder;
    holder.AddAttr(new AttributeInteger("LOC", "1"));
    holder.AddAttr(new AttributeString("loc", "2"));
    AttributeHolder copy(holder);
    EXPECT_EQ(NamesOf(copy.GetAttrIterator()), (Names{"LOC", "loc"}));
    EXPECT_NE(copy.GetAttr("loc"), holder.GetAttr("loc"));
    EXPECT_EQ(copy.GetAttr("LOC")->GetValueString(), "2");
    copy.GetAttr("LOC")->SetValue("3");
    EXPECT_EQ(holder.GetAttr("LOC")->GetValueString(), "2");

    AttributeHolder assigned;
    assigned.AddAttr(new AttributeString("old", ""));
    assigned = holder;
    EXPECT_EQ(assigned.GetAttr("old"), nullptr);
    EXPECT_EQ(NamesOf(assigned.GetAttrIterator()), (Names{"LOC", "loc"}));
    AttributeHolder& same = assigned;
    assigned = same;
    EXPECT_EQ(NamesOf(assigned.GetAttrIterator()), (Names{"LOC", "loc"}));
    assigned = AttributeHolder();
    EXPECT_TRUE(assigned.GetAttrIterator().IsAtEnd());
    EXPECT_EQ(assigned.GetAttr("LOC"), nullptr);
    assigned.AddAttr(new AttributeString("new", ""));
    EXPECT_NE(assigned.GetAttr("NEW"), nullptr);
}

TEST(AttributeHolder, AnIteratorSeesWhatIsAddedOrAssignedLater) {
    AttributeHolder holder;
    auto at = holder.GetAttrIterator();
    const auto start = at;
    EXPECT_TRUE(at.IsAtEnd());
    EXPECT_EQ(at.GetCurrent(), nullptr);
    holder.AddAttr(new AttributeString("a", ""));
    EXPECT_FALSE(at.IsAtEnd());
    EXPECT_EQ(at.GetCurrent(), holder.GetAttr("a"));
    EXPECT_EQ(NamesOf(start), Names{"a"});
    AttributeHolder other;
    other.AddAttr(new AttributeString("b", ""));
    other.AddAttr(new AttributeString("c", ""));
    holder = other;
    EXPECT_EQ(at.GetCurrent(), holder.GetAttr("b"));
    at.Next();
    EXPECT_EQ(at.GetCurrent(), holder.GetAttr("c"));
    auto cursor = start.begin();
    holder = AttributeHolder();
    EXPECT_TRUE(at.IsAtEnd());
    EXPECT_EQ(cursor, start.end());
    EXPECT_EQ(*cursor, nullptr);
    holder.AddAttr(new AttributeString("d", ""));
    EXPECT_EQ(*cursor, holder.GetAttr("d"));
}

TEST(AttributeHolder, HoldsManyAttributes) {
    AttributeHolder holder;
    for (int i = 0; i < 20000; ++i) {
        holder.AddAttr(
            new AttributeInteger(("A" + std::to_string(i)).c_str(), std::to_string(i).c_str()));
    }
    for (int i = 0; i < 20000; i += 7) {
        ASSERT_EQ(holder.GetAttr(("a" + std::to_string(i)).c_str())->GetValueString(),
                  std::to_string(i).c_str());
    }
}

TEST(AttributeHolder, SurvivesAttributesThatAreRenamed) {
    AttributeHolder holder;
    holder.AddAttr(new AttributeString("a", "1"));
    holder.AddAttr(new AttributeString("b", "2"));
    holder.GetAttr("a")->SetName("a much longer name than before");
    holder.GetAttr("b")->SetName("");
    const AttributeHolder copy(holder);
    EXPECT_EQ(NamesOf(holder.GetAttrIterator()), (Names{"a much longer name than before", ""}));
    EXPECT_EQ(NamesOf(copy.GetAttrIterator()), NamesOf(holder.GetAttrIterator()));
}

} // namespace
