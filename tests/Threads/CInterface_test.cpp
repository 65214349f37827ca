// The C interface in several threads: engines in parallel, and one model that all of them read.
#include "Orn_Hdl/orn_hdl.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

namespace {

constexpr int ThreadCount = 4;

template <class Action> void InThreads(const Action& action) {
    std::vector<std::thread> threads;
    for (int i = 0; i < ThreadCount; ++i) {
        threads.emplace_back(action, i);
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
}

void Execute(orn_hdl_model_t model, const std::string& line) {
    EXPECT_EQ(orn_hdl_model_execute(model, line.c_str()), ORN_HDL_OK) << line;
}

TEST(CInterfaceThreads, EnginesWorkInParallel) {
    InThreads([](int thread) {
        for (int i = 0; i < 50; ++i) {
            orn_hdl_engine_t engine;
            orn_hdl_model_t model;
            ASSERT_EQ(orn_hdl_engine_create(&engine), ORN_HDL_OK);
            ASSERT_EQ(orn_hdl_engine_add_model(engine, "top", "", &model), ORN_HDL_OK);
            Execute(model, "ADD PORT P" + std::to_string(thread) + " input");
            EXPECT_EQ(orn_hdl_model_execute(model, "NONSENSE"), ORN_HDL_FAILED);
            orn_hdl_error_t error;
            ASSERT_EQ(orn_hdl_model_error(model, &error), ORN_HDL_OK);
            EXPECT_STREQ(error.text.data, "Command not find.\n");
            EXPECT_EQ(orn_hdl_engine_destroy(engine), ORN_HDL_OK);
            EXPECT_EQ(orn_hdl_model_execute(model, "NOOP"), ORN_HDL_DEAD_HANDLE);
        }
    });
}

TEST(CInterfaceThreads, AllReadOneModel) {
    orn_hdl_engine_t engine;
    orn_hdl_model_t model;
    ASSERT_EQ(orn_hdl_engine_create(&engine), ORN_HDL_OK);
    ASSERT_EQ(orn_hdl_engine_add_model(engine, "top", "", &model), ORN_HDL_OK);
    Execute(model, "ADD COMPONENT INV");
    Execute(model, "ADD PIN INV I input");
    for (int i = 0; i < 100; ++i) {
        const std::string number = std::to_string(i);
        Execute(model, "ADD INSTANCE INV U" + number);
        Execute(model, "CONNECT SIGNAL N" + number + " U" + number + ".I");
    }
    InThreads([model](int) {
        orn_hdl_object_t netlist;
        orn_hdl_object_t instance;
        orn_hdl_cursor_t cursor;
        ASSERT_EQ(orn_hdl_model_get_netlist(model, &netlist), ORN_HDL_OK);
        ASSERT_EQ(orn_hdl_object_walk(netlist, ORN_HDL_INSTANCES, &cursor), ORN_HDL_OK);
        int count = 0;
        for (; orn_hdl_cursor_next(&cursor, &instance) == ORN_HDL_OK; ++count) {
            orn_hdl_wire_t wire;
            size_t pins = 0;
            EXPECT_EQ(orn_hdl_instance_get_wires(instance, &wire, 1, &pins), ORN_HDL_OK);
            EXPECT_EQ("N" + std::to_string(count), wire.signal.data);
        }
        EXPECT_EQ(count, 100);
        orn_hdl_findings_t findings;
        EXPECT_EQ(orn_hdl_model_check(model, ORN_HDL_ALL_TARGETS, &findings), ORN_HDL_OK);
        EXPECT_EQ(orn_hdl_findings_destroy(findings), ORN_HDL_OK);
    });
    EXPECT_EQ(orn_hdl_engine_destroy(engine), ORN_HDL_OK);
}

} // namespace
