// Comments of an architecture's objects, and those that hide text from synthesis.
#pragma once

#include "Orn_Hdl/Model/Object.h"
#include "Readers/Vhdl/Scanner.h"

#include <string>
#include <vector>

namespace Orn_Hdl::Readers::Vhdl {

class Notes {
public:
    /// \param keepsComments whether comments become comments of objects.
    /// \param obeysAll as `TakeSwitch` takes it.
    Notes(Scanner& scanner, bool keepsComments, bool obeysAll)
        : scanner_(scanner), keepsComments_(keepsComments), obeysAll_(obeysAll) {}

    /// Begins or stops to collect comments with the next token.
    void Collect(bool isOn);
    /// Takes the comments in front of what follows.
    void TakeBefore();
    /// Takes the comments inside of a statement, which say no more than what is hidden.
    void TakeInside();
    /// Gives the comments in front of a statement to an object that it declares.
    void GiveTo(Object& object);
    /// Gives the comments in front of a design unit to an object, but for a banner.
    void GiveUnitTo(Object& object);
    /// Takes the comments inside of the statement whose semicolon is the former token, and drops
    /// those in front of it that are not given yet.
    void EndStatement();
    /// Drops what is not given yet.
    void Drop();

    /// Whether what follows is hidden from synthesis ("translate_off").
    bool IsHidden() const noexcept { return isHidden_; }

private:
    Scanner& scanner_;
    const bool keepsComments_;
    const bool obeysAll_;
    std::vector<std::string> lines_;
    bool isHidden_ = false;
};

} // namespace Orn_Hdl::Readers::Vhdl
