#include "Orn_Hdl/Model.h"

#include "Support/Names.h"

#include <gtest/gtest.h>

#include <cctype>
#include <climits>
#include <memory>
#include <optional>
#include <string>

namespace {

using namespace Orn_Hdl;
using Support::NamesOf;

TEST(Polarity, StartsInvalid) {
    const Polarity polarity;
    EXPECT_EQ(polarity.GetValue(), -1);
    EXPECT_FALSE(polarity.IsValid());
    EXPECT_STREQ(polarity.GetValueName(), "Output") << "no text for an invalid direction exists";
}

TEST(Polarity, IsReadFromEveryBeginningOfItsWordInAnyCase) {
    const std::string words[] = {"Input", "Output", "BiDirectional"};
    for (int value = 0; value < 3; ++value) {
        const std::string& word = words[value];
        for (std::size_t length = 1; length <= word.size(); ++length) {
            std::string text = word.substr(0, length);
            EXPECT_EQ(Polarity::GetValue(text.c_str()), value) << text;
            for (char& c : text) {
                c = static_cast<char>(std::isupper(c) != 0 ? std::tolower(c) : std::toupper(c));
            }
            EXPECT_EQ(Polarity(text.c_str()).GetValue(), value) << text;
            EXPECT_EQ(Polarity::GetValue((text + "!").c_str()), -1) << text;
        }
        EXPECT_EQ(Polarity::GetValue((word + "s").c_str()), -1);
        EXPECT_STREQ(Polarity(value).GetValueName(), word.c_str());
    }
}

TEST(Polarity, IsInvalidFromAnyOtherText) {
    for (const char* text :
         {"", "input2", "Inputs", "x", "inout", " in", "0", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(Polarity::GetValue(text), -1);
    }
    EXPECT_EQ(Polarity("bi").GetValue(), 2);
}

TEST(Polarity, ParsesWhatATextNamesOrFails) {
    EXPECT_EQ(Polarity::Parse("in"), Polarity(Polarity::Input));
    EXPECT_EQ(Polarity::Parse("OUTPUT"), Polarity(Polarity::Output));
    EXPECT_EQ(Polarity::Parse(std::string("bidir")), Polarity(Polarity::BiDirectional));
    EXPECT_EQ(Polarity::Parse("inout"), Polarity(Polarity::BiDirectional));
    EXPECT_EQ(Polarity::Parse("InOut"), Polarity(Polarity::BiDirectional));
    for (const char* text : {"", "inou", "inouts", "inputs", "sideways", " in"}) {
        EXPECT_EQ(Polarity::Parse(text), std::nullopt) << text;
    }
    EXPECT_EQ(Polarity::Parse(nullptr), std::nullopt);
    // Of a constructor, these words are invalid, as they always were.
    EXPECT_FALSE(Polarity("inout").IsValid());
}

TEST(Polarity, IsMadeFromItsEnumerators) {
    const Polarity output = Polarity::Output;
    EXPECT_EQ(output.GetValue(), 1);
    EXPECT_EQ(output, Polarity::Output);
    EXPECT_FALSE(Polarity(Polarity::Invalid).IsValid());
}

TEST(Polarity, OnlyThreeValuesAreValid) {
    for (int value = -3; value < 6; ++value) {
        EXPECT_EQ(Polarity::IsValidValue(value), value >= 0 && value <= 2) << value;
        EXPECT_EQ(Polarity(value).IsValid(), value >= 0 && value <= 2) << value;
    }
    EXPECT_FALSE(Polarity::IsValidValue(INT_MIN));
    EXPECT_FALSE(Polarity::IsValidValue(INT_MAX));
    EXPECT_STREQ(Polarity(3).GetValueName(), "Output");
    EXPECT_STREQ(Polarity(INT_MIN).GetValueName(), "Output");
}

TEST(Polarity, ComparesAsASignedNumber) {
    EXPECT_TRUE(Polarity() < Polarity("in"));
    EXPECT_TRUE(Polarity("in") < Polarity("out"));
    EXPECT_TRUE(Polarity("out") < Polarity("bi"));
    EXPECT_FALSE(Polarity("bi") < Polarity("bi"));
    EXPECT_TRUE(Polarity(1) == Polarity("output"));
    EXPECT_TRUE(Polarity(1) != Polarity("input"));
}

TEST(Polarity, CanBeSet) {
    Polarity polarity;
    polarity.SetValue(2);
    EXPECT_EQ(polarity.GetValue(), 2);
    polarity.SetValue("o");
    EXPECT_EQ(polarity.GetValue(), 1);
    polarity.SetValue("");
    EXPECT_EQ(polarity.GetValue(), -1);
    const Polarity copy(Polarity("in"));
    polarity = copy;
    EXPECT_EQ(polarity.GetValue(), 0);
}

TEST(Pin, TakesTheClassThatItsNormalisedNameAsksFor) {
    const auto typeOf = [](const char* name) {
        const std::unique_ptr<Pin> pin(Pin::Create(name, Polarity("in")));
        return pin->GetPinType();
    };
    EXPECT_EQ(typeOf("CLK"), 1);
    EXPECT_EQ(typeOf("D(7:0)"), 2);
    EXPECT_EQ(typeOf("D[7:0]"), 2);
    EXPECT_EQ(typeOf("D<7-0>"), 2);
    EXPECT_EQ(typeOf("D(7)"), 3);
    EXPECT_EQ(typeOf("D{7}"), 3);
    EXPECT_EQ(typeOf("D(7"), 1);
    EXPECT_EQ(typeOf("D(-7)"), 1) << "the - becomes a :";
    EXPECT_EQ(typeOf(""), 1);
    EXPECT_EQ(typeOf(nullptr), 1);
}

TEST(Pin, KnowsItsBaseName) {
    EXPECT_EQ(ScalarPin("CLK", Polarity("in")).GetBaseName(), "CLK");
    EXPECT_EQ(BusPin("D(7:0)", Polarity("in")).GetBaseName(), "D");
    EXPECT_EQ(BusIndexPin("D(3)", Polarity("in")).GetBaseName(), "D");
}

TEST(BusPin, KnowsItsRange) {
    const BusPin pin("A[0:+3]", Polarity("in"));
    Port::String left;
    Port::String right;
    EXPECT_TRUE(pin.GetIndex(left, right));
    EXPECT_EQ(left, "0");
    EXPECT_EQ(right, "+3");
    EXPECT_EQ(pin.GetWidth(), 4);
    EXPECT_FALSE(pin.IsDownTo());
    EXPECT_TRUE(BusPin("A(3:0)", Polarity()).IsDownTo());
    EXPECT_EQ(BusPin("A(3:3)", Polarity()).GetWidth(), 1);
    EXPECT_FALSE(BusPin("A(3:3)", Polarity()).IsDownTo());
}

TEST(BusPin, WithoutARangeHasWidthZero) {
    const BusPin pin("A", Polarity("in"));
    Port::String left("l");
    Port::String right("r");
    EXPECT_FALSE(pin.GetIndex(left, right));
    EXPECT_EQ(left, "l");
    EXPECT_EQ(right, "r");
    EXPECT_EQ(pin.GetWidth(), 0);
    EXPECT_FALSE(pin.IsDownTo());
}

TEST(BusPin, WidthIsClampedToTheGreatestInt) {
    EXPECT_EQ(BusPin("A(2147483647:0)", Polarity()).GetWidth(), INT_MAX);
    EXPECT_EQ(BusPin("A(99999999999:1)", Polarity()).GetWidth(), INT_MAX);
    EXPECT_EQ(BusPin("A(2147483647:2147483647)", Polarity()).GetWidth(), 1);
}

TEST(BusIndexPin, KnowsItsIndexText) {
    EXPECT_EQ(BusIndexPin("A(+03)", Polarity()).GetIndex(), "+03");
    EXPECT_EQ(BusIndexPin("A", Polarity()).GetIndex(), "");
}

TEST(Pin, ConnectSetsThePinsSideOnly) {
    ScalarPin pin("A", Polarity("in"));
    ScalarSignal signal("N");
    EXPECT_EQ(pin.GetSignal(), nullptr);
    pin.Connect(&signal);
    EXPECT_EQ(pin.GetSignal(), &signal);
    EXPECT_TRUE(signal.GetPinIterator().IsAtEnd());
    pin.Disconnect();
    EXPECT_EQ(pin.GetSignal(), nullptr);
    pin.Connect(nullptr);
    EXPECT_EQ(pin.GetSignal(), nullptr);
}

TEST(Pin, HasADirection) {
    ScalarPin pin("A", Polarity("in"));
    EXPECT_EQ(pin.GetPolarity(), Polarity("in"));
    EXPECT_STREQ(pin.GetPolarityName(), "Input");
    pin.SetPolarity(Polarity("bi"));
    EXPECT_STREQ(pin.GetPolarityName(), "BiDirectional");
    pin.SetPolarity(Polarity());
    EXPECT_STREQ(pin.GetPolarityName(), "Output");
}

TEST(Pin, HasADefaultValue) {
    ScalarPin pin("A", Polarity("in"));
    EXPECT_EQ(pin.GetDefaultValue().GetValue(), "");
    pin.SetDefaultValue("8:H:A5");
    EXPECT_EQ(pin.GetDefaultValue().GetValue(), "A5");
    EXPECT_EQ(pin.GetDefaultValue().GetLength(), 8);
    EXPECT_EQ(pin.GetDefaultValue().GetBase(), 16);
    pin.SetDefaultValue(BitVectorValue("1"));
    EXPECT_EQ(pin.GetDefaultValue().GetValue(), "1");
    EXPECT_FALSE(pin.GetDefaultValue().HasBaseAndLength());
    pin.SetDefaultValue(pin.GetDefaultValue());
    EXPECT_EQ(pin.GetDefaultValue().GetValue(), "1");
    pin.SetDefaultValue(static_cast<const char*>(nullptr));
    EXPECT_EQ(pin.GetDefaultValue().GetValue(), "");
}

template <class T> class EachPin : public testing::Test {
public:
    static const char* GetName() {
        return std::is_same_v<T, ScalarPin> ? "A" : std::is_same_v<T, BusPin> ? "A(3:0)" : "A(3)";
    }
};

using PinClasses = testing::Types<ScalarPin, BusPin, BusIndexPin>;
TYPED_TEST_SUITE(EachPin, PinClasses);

TYPED_TEST(EachPin, ClonesNamePolarityAndDefaultValueOnly) {
    ScalarSignal signal("N");
    std::unique_ptr<Pin> clone;
    {
        TypeParam pin(this->GetName(), Polarity("in"));
        pin.SetDefaultValue("1");
        pin.AddComment("comment");
        pin.AddAttr(new AttributeString("a", "b"));
        signal.Connect(&pin);
        clone.reset(pin.ClonePin());
    }
    EXPECT_NE(dynamic_cast<TypeParam*>(clone.get()), nullptr);
    EXPECT_EQ(clone->GetName(), this->GetName());
    EXPECT_EQ(clone->GetPolarity(), Polarity("in"));
    EXPECT_EQ(clone->GetDefaultValue().GetValue(), "1");
    EXPECT_EQ(clone->GetSignal(), nullptr);
    EXPECT_EQ(clone->GetComment(), "");
    EXPECT_FALSE(clone->HasAttrs());
    EXPECT_EQ(clone->GetObjectType(), 102);
}

TYPED_TEST(EachPin, AssignmentTakesNamePolarityAndDefaultValueOnly) {
    ScalarSignal mine("M");
    ScalarSignal others("O");
    TypeParam target(this->GetName(), Polarity("in"));
    target.AddComment("mine");
    target.AddAttr(new AttributeString("a", "mine"));
    mine.Connect(&target);
    TypeParam source("X", Polarity("out"));
    source.SetDefaultValue("1");
    source.AddComment("other");
    source.AddAttr(new AttributeString("b", "other"));
    others.Connect(&source);
    target = source;
    EXPECT_EQ(target.GetName(), "X");
    EXPECT_EQ(target.GetPolarity(), Polarity("out"));
    EXPECT_EQ(target.GetDefaultValue().GetValue(), "1");
    EXPECT_EQ(target.GetSignal(), &mine);
    EXPECT_EQ(target.GetComment(), "mine\n");
    EXPECT_EQ(NamesOf(target.GetAttrIterator()), Support::Names{"a"});
    EXPECT_EQ(source.GetSignal(), &others);
    TypeParam& same = target;
    target = same;
    EXPECT_EQ(target.GetName(), "X");
    EXPECT_EQ(target.GetSignal(), &mine);
    source.SetDefaultValue("");
    target = source;
    EXPECT_EQ(target.GetDefaultValue().GetValue(), "");
}

TEST(PinConstantSignalVisitor, FormsTheNameOfTheConstantsSignal) {
    PinConstantSignalVisitor visitor("U1");
    EXPECT_EQ(visitor.GetName(), "");
    ScalarPin scalar("CE", Polarity("in"));
    scalar.AcceptPin(visitor);
    EXPECT_EQ(visitor.GetName(), "U1_CE_CONST_SIGNAL");
    BusPin bus("D(+3:00)", Polarity("in"));
    bus.AcceptPin(visitor);
    EXPECT_EQ(visitor.GetName(), "U1_D_CONST_SIGNAL(+3:00)");
    BusIndexPin bit("D(02)", Polarity("in"));
    bit.AcceptPin(visitor);
    EXPECT_EQ(visitor.GetName(), "U1_D_CONST_SIGNAL(02)");
}

} // namespace
