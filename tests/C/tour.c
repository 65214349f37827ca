/* A C program's view of the interface, called by Tour_test.cpp. */
#include "C/tour.h"

#include "Orn_Hdl/orn_hdl.h"

#include <stdio.h>
#include <string.h>

static size_t CountObjects(orn_hdl_object_t owner, int32_t list) {
    orn_hdl_cursor_t cursor;
    orn_hdl_object_t object;
    size_t count = 0;
    if (orn_hdl_object_walk(owner, list, &cursor) == ORN_HDL_OK) {
        while (orn_hdl_cursor_next(&cursor, &object) == ORN_HDL_OK) {
            ++count;
        }
    }
    return count;
}

int RunTour(char* result, size_t size) {
    orn_hdl_engine_t engine = {0};
    orn_hdl_model_t model = {0};
    orn_hdl_object_t netlist;
    orn_hdl_text_t name;
    orn_hdl_error_t error;
    int status = 1;
    if (orn_hdl_engine_create(&engine) == ORN_HDL_OK &&
        orn_hdl_engine_add_model(engine, "top", NULL, &model) == ORN_HDL_OK &&
        orn_hdl_model_execute(model, "ADD PORT A input") == ORN_HDL_OK &&
        orn_hdl_model_add_port(model, "Y(3:0)", "output") == ORN_HDL_OK &&
        orn_hdl_model_add_port(model, "A", "output") == ORN_HDL_FAILED &&
        orn_hdl_model_get_netlist(model, &netlist) == ORN_HDL_OK) {
        const size_t signals = CountObjects(netlist, ORN_HDL_SIGNALS);
        if (orn_hdl_model_error(model, &error) == ORN_HDL_OK) {
            snprintf(result, size, "%lu signals; %s", (unsigned long)signals, error.text.data);
            status = 0;
        }
        if (orn_hdl_object_get_name(netlist, &name) != ORN_HDL_OK ||
            strcmp(name.data, "top") != 0) {
            status = 1;
        }
    }
    return orn_hdl_engine_destroy(engine) == ORN_HDL_OK ? status : 1;
}
