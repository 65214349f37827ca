// The rules by which designs are checked.
#pragma once

#include "Orn_Hdl/Check.h"

namespace Orn_Hdl::Checking {

/// The rules, in the order of the table in Rules.cpp.
enum class RuleId {
    ReservedWord,
    IllegalName,
    Underscores,
    NameLength,
    BitPin,
    PinTwice,
    NameClash,
    ModuleName,
    OwnComponent,
    HiddenLibrary,
    PredefinedName,
    PredefinedAttribute,
    PinWidth,
    SliceOutside,
    AliasWidth,
    AliasBits,
    WideBus,
    ConstantDigits,
    ConstantWidth,
    ConstantLength,
    ConstantCharacter,
    ConstantLeftOut,
    NoPorts,
    OpenInput,
    OpenBit,
    OpenMember,
    OpenSignal,
    OpenSignalTaken,
    LatePin,
    AssignedInput,
    DrivenInput,
    TwoDrivers,
    Undriven,
    AliasLoop,
    OutputRead,
    DummyTaken,
    AttributeTypes,
    UndeclaredAttribute,
    UserType,
    UserValue,
    UndeclaredGeneric,
    GenericType,
    GenericDigits,
    HiddenGeneric,
    FloatGeneric,
    QuoteInValue,
    CommentInValue,
    BackslashInValue,
    CharacterInValue,
    DirectiveComment,
    MissingConfiguration,
    UndeclaredComponent,
    LibraryClause,
    UseClause,
    NeededLibrary,
    NoStdLogic,
    IncludeFile,
    Count
};

/// The rule's entry in the table.
const Check::Rule& GetRule(RuleId rule) noexcept;

} // namespace Orn_Hdl::Checking
