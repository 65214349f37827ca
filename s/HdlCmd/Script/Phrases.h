// The phrases that a script of commands consists of. They are spelt in the catalogue alone.
#pragma once

#include "HdlCmd/Catalogue.h"

#include <string_view>
#include <vector>

namespace Orn_Hdl::Script {

/// A phrase of the catalogue.
struct Phrase {
    /// \param execute what the command does.
    explicit Phrase(CommandExecution execute);

    std::string_view text;
    /// What makes a longer phrase of this one. If the words of a line spell one of these, the line
    /// is another command.
    std::vector<std::string_view> continuations;
};

/// The phrases for the comment and the attributes of one kind of object.
struct HolderPhrases {
    Phrase addComment;
    Phrase addAttribute;
    Phrase setUserType;
    Phrase setOptions;
};

/// The phrases of a script.
struct Phrases {
    /// All of them, looked up once.
    static const Phrases& Get();

    Phrase setNetlistName;
    Phrase setSourceFile;
    Phrase setApplication;
    Phrase setCommand;
    Phrase setDevice;
    Phrase setPurpose;
    Phrase setReference;
    Phrase setSynthesis;
    Phrase uppercase;
    Phrase lowercase;
    Phrase addInclude;
    Phrase addLibrary;
    Phrase addUseLibrary;
    Phrase useDefaultLibrary;
    Phrase flattenBus;
    Phrase suppressConfiguration;
    Phrase suppressComponent;
    Phrase useAttrType;
    Phrase setOpenPin;

    Phrase addComponent;
    Phrase addPin;
    Phrase addPort;
    Phrase addSignal;
    Phrase addInstance;
    Phrase connectSignal;
    Phrase assignConstant;

    HolderPhrases module;
    HolderPhrases component;
    HolderPhrases instance;
    HolderPhrases signal;
    HolderPhrases componentPin;
    HolderPhrases instancePin;
};

} // namespace Orn_Hdl::Script
