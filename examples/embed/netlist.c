/* Replays a command file, prints what is wired to what, and writes the design as Verilog, all
   through the C interface.

   netlist FILE */

#include <Orn_Hdl/orn_hdl.h>

#include <stdio.h>

/* Prints the text of the model's last failure, with the line of the command file if there is one.
 */
static int Complain(orn_hdl_model_t model) {
    orn_hdl_error_t error;
    if (orn_hdl_model_error(model, &error) == ORN_HDL_OK) {
        if (error.line != 0) {
            fprintf(stderr, "%s:%lu: ", error.file.data, (unsigned long)error.line);
        }
        fprintf(stderr, "%s\n", error.text.data);
    }
    return 1;
}

static int PrintWire(void* user, const orn_hdl_text_t* instance, const orn_hdl_wire_t* wire) {
    FILE* out = (FILE*)user;
    fprintf(out, "%s.%s %s %s\n", instance->data, wire->pin.data,
            wire->direction == ORN_HDL_INPUT ? "<-" : "->",
            wire->signal.length == 0 ? "(open)" : wire->signal.data);
    return 0;
}

static int PrintPorts(orn_hdl_model_t model) {
    static const char* const directions[] = {"input", "output", "inout"};
    orn_hdl_object_t netlist;
    orn_hdl_cursor_t signals;
    orn_hdl_object_t signal;
    if (orn_hdl_model_get_netlist(model, &netlist) != ORN_HDL_OK ||
        orn_hdl_object_walk(netlist, ORN_HDL_SIGNALS, &signals) != ORN_HDL_OK) {
        return 1;
    }
    while (orn_hdl_cursor_next(&signals, &signal) == ORN_HDL_OK) {
        int32_t kind;
        int32_t direction;
        int32_t width;
        orn_hdl_text_t name;
        if (orn_hdl_object_get_kind(signal, &kind) != ORN_HDL_OK ||
            orn_hdl_object_get_direction(signal, &direction) != ORN_HDL_OK ||
            orn_hdl_object_get_width(signal, &width) != ORN_HDL_OK ||
            orn_hdl_object_get_name(signal, &name) != ORN_HDL_OK) {
            return 1;
        }
        if (direction != ORN_HDL_NO_DIRECTION &&
            (kind == ORN_HDL_KIND_SCALAR || kind == ORN_HDL_KIND_BUS)) {
            printf("%s %s, width %d\n", directions[direction], name.data, (int)width);
        }
    }
    return 0;
}

static int Run(orn_hdl_model_t model, const char* fileName) {
    char* verilog;
    if (orn_hdl_model_replay(model, fileName, NULL, NULL, NULL) != ORN_HDL_OK) {
        return Complain(model);
    }
    if (PrintPorts(model) != 0 ||
        orn_hdl_model_visit_wires(model, &PrintWire, stdout) != ORN_HDL_OK) {
        return 1;
    }
    if (orn_hdl_model_set_number(model, ORN_HDL_WRITE_HEADER, 0) != ORN_HDL_OK ||
        orn_hdl_model_write_text(model, ORN_HDL_VERILOG, &verilog, NULL) != ORN_HDL_OK) {
        return Complain(model);
    }
    fputs(verilog, stdout);
    orn_hdl_free(verilog);
    return 0;
}

int main(int argc, char** argv) {
    orn_hdl_engine_t engine;
    orn_hdl_model_t model;
    int status = 1;
    if (argc != 2) {
        fputs("usage: netlist FILE\n", stderr);
        return 2;
    }
    if (orn_hdl_engine_create(&engine) != ORN_HDL_OK) {
        return 1;
    }
    if (orn_hdl_engine_add_model(engine, "netlist", argv[1], &model) == ORN_HDL_OK) {
        status = Run(model, argv[1]);
    }
    orn_hdl_engine_destroy(engine);
    return status;
}
