#include "Orn_Hdl/Exception.h"

#include <gtest/gtest.h>

#include <exception>
#include <string>
#include <type_traits>

namespace {

Orn_Hdl::Exception MakeException() {
    Orn_Hdl::Exception exception("DesignEntry", "../s/HdlModel", "$Revision: 1.8 $", 42);
    exception.setDescription("Invalid Name.\n");
    return exception;
}

TEST(Exception, TellsWhereItWasRaisedAndWhatHappened) {
    const Orn_Hdl::Exception exception = MakeException();
    EXPECT_EQ(exception.GetModule(), "DesignEntry");
    EXPECT_EQ(exception.GetSourceUnit(), "../s/HdlModel");
    EXPECT_EQ(exception.GetRevision(), "$Revision: 1.8 $");
    EXPECT_EQ(exception.GetLine(), 42);
    EXPECT_EQ(exception.getLocalized(), "Invalid Name.\n");
    EXPECT_STREQ(exception.what(), "Invalid Name.\n");
}

TEST(Exception, ReportHoldsEverything) {
    const std::string report(MakeException().report().GetView());
    for (const char* part :
         {"DesignEntry", "../s/HdlModel", "$Revision: 1.8 $", "42", "Invalid Name.\n"}) {
        EXPECT_NE(report.find(part), std::string::npos) << part << " in " << report;
    }
}

TEST(Exception, UserTextInADescriptionIsNoFormat) {
    Orn_Hdl::Exception exception = MakeException();
    exception.setDescription("%s%n%d");
    EXPECT_EQ(exception.getLocalized(), "%s%n%d");
    EXPECT_NE(std::string(exception.report().GetView()).find("%s%n%d"), std::string::npos);
    exception.setDescription(nullptr);
    EXPECT_EQ(exception.getLocalized(), "");
}

TEST(Exception, CopiesStandAlone) {
    Orn_Hdl::Exception copy("", "", "", 0);
    {
        const Orn_Hdl::Exception original = MakeException();
        copy = original;
    }
    const Orn_Hdl::Exception second(copy);
    EXPECT_EQ(second.getLocalized(), "Invalid Name.\n");
    EXPECT_EQ(second.GetLine(), 42);
}

TEST(Exception, IsCaughtAsEveryBase) {
    EXPECT_THROW(throw MakeException(), Orn_Hdl::Exception);
    EXPECT_THROW(throw MakeException(), Port::Exception);
    EXPECT_THROW(throw MakeException(), std::exception);
    EXPECT_EQ(sizeof(Orn_Hdl::Exception), sizeof(Port::Exception)) << "it has no field of its own";
}

} // namespace
