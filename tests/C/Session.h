// An engine with one model, made and destroyed through the C interface.
#pragma once

#include "Orn_Hdl/orn_hdl.h"

#include <gtest/gtest.h>

#include <string>

namespace CTests {

inline std::string ToString(const orn_hdl_text_t& text) {
    return std::string(text.data, text.length);
}

struct Session {
    Session() {
        EXPECT_EQ(orn_hdl_engine_create(&engine), ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_engine_add_model(engine, "top", "", &model), ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_engine_use_model(engine, "top"), ORN_HDL_OK);
    }
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;
    ~Session() { EXPECT_EQ(orn_hdl_engine_destroy(engine), ORN_HDL_OK); }

    /// Executes lines, all of which succeed.
    void Run(const std::string& lines) const {
        EXPECT_EQ(orn_hdl_model_execute_lines(model, lines.data(), lines.size()), ORN_HDL_OK)
            << GetError();
    }
    std::string GetError() const {
        orn_hdl_error_t error;
        EXPECT_EQ(orn_hdl_model_error(model, &error), ORN_HDL_OK);
        return ToString(error.text);
    }
    orn_hdl_object_t GetSignal(const char* name) const {
        orn_hdl_object_t signal = {};
        EXPECT_EQ(orn_hdl_model_get_signal(model, name, &signal), ORN_HDL_OK) << name;
        return signal;
    }
    orn_hdl_object_t GetInstance(const char* name) const {
        orn_hdl_object_t instance = {};
        EXPECT_EQ(orn_hdl_model_get_instance(model, name, &instance), ORN_HDL_OK) << name;
        return instance;
    }

    orn_hdl_engine_t engine = {};
    orn_hdl_model_t model = {};
};

inline std::string NameOf(orn_hdl_object_t object) {
    orn_hdl_text_t name;
    EXPECT_EQ(orn_hdl_object_get_name(object, &name), ORN_HDL_OK);
    return ToString(name);
}

/// A netlist in memory, without its header.
inline std::string TextOf(orn_hdl_model_t model, orn_hdl_language_t language) {
    EXPECT_EQ(orn_hdl_model_set_number(model, ORN_HDL_WRITE_HEADER, 0), ORN_HDL_OK);
    char* text = nullptr;
    size_t length = 0;
    EXPECT_EQ(orn_hdl_model_write_text(model, language, &text, &length), ORN_HDL_OK);
    std::string result(text, length);
    orn_hdl_free(text);
    return result;
}

/// Two components, two instances, a bus, a compound.
inline constexpr const char* SmallDesign = "ADD COMPONENT INV\n"
                                           "ADD PIN INV I input\n"
                                           "ADD PIN INV O output\n"
                                           "ADD COMPONENT ROM\n"
                                           "ADD PIN ROM A(3:0) input 4:H:A\n"
                                           "ADD PORT D(7:0) input\n"
                                           "ADD PORT Y output\n"
                                           "ADD INSTANCE INV U1\n"
                                           "ADD INSTANCE ROM U2\n"
                                           "CONNECT SIGNAL D(2) U1.I\n"
                                           "CONNECT SIGNAL Y U1.O\n"
                                           "CONNECT SIGNAL D(7:6),D(1:0) U2.A(3:0)\n"
                                           "ADD SIGNAL ATTRIBUTE Y LOC P4\n"
                                           "ADD INSTANCE COMMENT U1 first\n"
                                           "ASSIGN CONSTANT N 1\n";

} // namespace CTests
