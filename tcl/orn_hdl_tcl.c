/* The Tcl package orn_hdl, over the C interface of the library.

   Each interpreter has an engine of its own, made by the first command that needs it. A model is a
   Tcl command: deleting the command destroys the model, and the engine goes with the interpreter.
 */

#include <Orn_Hdl/orn_hdl.h>

#include <stdio.h>
#include <string.h>
#include <tcl.h>

#define ASSOCIATED_KEY "orn_hdl"

/* What the package keeps for an interpreter. */
typedef struct PackageState {
    orn_hdl_engine_t engine;
    orn_hdl_model_t current;
    unsigned long lastNumber;
} PackageState;

/* A model that has a Tcl command. */
typedef struct ModelCommand {
    PackageState* state;
    orn_hdl_model_t model;
} ModelCommand;

/* ---------------------------------------------------------------------------------------------- */
/* Results and errors                                                                             */

static const char* NameOfStatus(orn_hdl_status_t status) {
    static const char* const names[] = {"OK",         "END",       "NULL_HANDLE", "DEAD_HANDLE",
                                        "WRONG_KIND", "ARGUMENT",  "NOT_FOUND",   "EXISTS",
                                        "FAILED",     "FILE",      "DIFFERS",     "BUSY",
                                        "STOPPED",    "NO_MEMORY", "UNEXPECTED"};
    const int count = (int)(sizeof(names) / sizeof(names[0]));
    return status >= 0 && status < count ? names[status] : "UNEXPECTED";
}

/* Makes a Tcl error of a failure: the message without its last line feed, in front of it the line
   of the command file, and the error code {ORN_HDL STATUS ?FILE LINE?}. */
static int SetError(Tcl_Interp* interp, orn_hdl_status_t status, const orn_hdl_error_t* error) {
    Tcl_Obj* code = Tcl_NewListObj(0, NULL);
    Tcl_Obj* message = Tcl_NewObj();
    const char* text = orn_hdl_status_text(status);
    size_t length = strlen(text);
    const int isTold = error != NULL && error->status == status;
    if (isTold && error->text.length > 0) {
        text = error->text.data;
        length = error->text.length;
    }
    if (length > 0 && text[length - 1] == '\n') {
        --length;
    }
    Tcl_ListObjAppendElement(NULL, code, Tcl_NewStringObj("ORN_HDL", -1));
    Tcl_ListObjAppendElement(NULL, code, Tcl_NewStringObj(NameOfStatus(status), -1));
    if (isTold && error->line > 0) {
        Tcl_Obj* file = Tcl_NewStringObj(error->file.data, (int)error->file.length);
        Tcl_Obj* line = Tcl_NewWideIntObj((Tcl_WideInt)error->line);
        Tcl_AppendPrintfToObj(message, "%s:%lu: ", error->file.data, (unsigned long)error->line);
        Tcl_ListObjAppendElement(NULL, code, file);
        Tcl_ListObjAppendElement(NULL, code, line);
    }
    Tcl_AppendToObj(message, text, (int)length);
    Tcl_SetObjResult(interp, message);
    Tcl_SetObjErrorCode(interp, code);
    return TCL_ERROR;
}

/* The result of a call with a model that has no other result. */
static int FinishModelCall(Tcl_Interp* interp, orn_hdl_model_t model, orn_hdl_status_t status) {
    orn_hdl_error_t error;
    if (status == ORN_HDL_OK) {
        return TCL_OK;
    }
    if (orn_hdl_model_error(model, &error) == ORN_HDL_OK) {
        return SetError(interp, status, &error);
    }
    return SetError(interp, status, NULL);
}

static int FinishEngineCall(Tcl_Interp* interp, orn_hdl_engine_t engine, orn_hdl_status_t status) {
    orn_hdl_error_t error;
    if (status == ORN_HDL_OK) {
        return TCL_OK;
    }
    if (orn_hdl_engine_error(engine, &error) == ORN_HDL_OK) {
        return SetError(interp, status, &error);
    }
    return SetError(interp, status, NULL);
}

static Tcl_Obj* ToObject(const orn_hdl_text_t* text) {
    return Tcl_NewStringObj(text->data, (int)text->length);
}

/* The name of a file as the system has it; null with an error in the interpreter. */
static const char* ToFileName(Tcl_Interp* interp, Tcl_Obj* name) {
    const char* native;
    if (Tcl_FSConvertToPathType(interp, name) != TCL_OK) {
        return NULL;
    }
    native = (const char*)Tcl_FSGetNativePath(name);
    if (native == NULL) {
        Tcl_SetObjResult(interp, Tcl_NewStringObj("no file of the system", -1));
        Tcl_SetErrorCode(interp, "ORN_HDL", "ARGUMENT", NULL);
    }
    return native;
}

static int ToLanguage(Tcl_Interp* interp, Tcl_Obj* name, int* language) {
    static const char* const names[] = {"verilog", "vhdl", NULL};
    return Tcl_GetIndexFromObj(interp, name, names, "language", 0, language);
}

/* ---------------------------------------------------------------------------------------------- */
/* Progress of a replay                                                                           */

typedef struct ProgressScript {
    Tcl_Interp* interp;
    Tcl_Obj* script;
    int result;
} ProgressScript;

static int OnProgress(void* user, uint64_t lines, uint64_t bytes) {
    ProgressScript* progress = (ProgressScript*)user;
    Tcl_Obj* command = Tcl_DuplicateObj(progress->script);
    Tcl_IncrRefCount(command);
    progress->result =
        Tcl_ListObjAppendElement(progress->interp, command, Tcl_NewWideIntObj((Tcl_WideInt)lines));
    if (progress->result == TCL_OK) {
        Tcl_ListObjAppendElement(NULL, command, Tcl_NewWideIntObj((Tcl_WideInt)bytes));
        progress->result = Tcl_EvalObjEx(progress->interp, command, TCL_EVAL_GLOBAL);
    }
    Tcl_DecrRefCount(command);
    return progress->result != TCL_OK;
}

static int Replay(Tcl_Interp* interp, orn_hdl_model_t model, Tcl_Obj* file, Tcl_Obj* script) {
    ProgressScript progress;
    orn_hdl_status_t status;
    const char* name = ToFileName(interp, file);
    if (name == NULL) {
        return TCL_ERROR;
    }
    progress.interp = interp;
    progress.script = script;
    progress.result = TCL_OK;
    status =
        orn_hdl_model_replay(model, name, script == NULL ? NULL : &OnProgress, NULL, &progress);
    if (status == ORN_HDL_STOPPED && progress.result == TCL_ERROR) {
        /* The error is the script's own. */
        return TCL_ERROR;
    }
    Tcl_ResetResult(interp);
    return FinishModelCall(interp, model, status);
}

/* ---------------------------------------------------------------------------------------------- */
/* The subcommands of a model                                                                     */

/* A list of the names in a list of the netlist. */
static int ListNames(Tcl_Interp* interp, orn_hdl_model_t model, int32_t which) {
    orn_hdl_object_t netlist;
    orn_hdl_object_t object;
    orn_hdl_cursor_t cursor;
    Tcl_Obj* names = Tcl_NewListObj(0, NULL);
    orn_hdl_status_t status = orn_hdl_model_get_netlist(model, &netlist);
    if (status == ORN_HDL_OK) {
        status = orn_hdl_object_walk(netlist, which, &cursor);
    }
    while (status == ORN_HDL_OK && (status = orn_hdl_cursor_next(&cursor, &object)) == ORN_HDL_OK) {
        orn_hdl_text_t name;
        status = orn_hdl_object_get_name(object, &name);
        if (status == ORN_HDL_OK) {
            Tcl_ListObjAppendElement(NULL, names, ToObject(&name));
        }
    }
    Tcl_SetObjResult(interp, names);
    return status == ORN_HDL_END ? TCL_OK : SetError(interp, status, NULL);
}

typedef struct WireList {
    Tcl_Obj* list;
} WireList;

static int OnWire(void* user, const orn_hdl_text_t* instance, const orn_hdl_wire_t* wire) {
    static const char* const directions[] = {"input", "output", "bidirectional"};
    const int isDirection = wire->direction >= 0 && wire->direction <= 2;
    Tcl_Obj* row[4];
    row[0] = ToObject(instance);
    row[1] = ToObject(&wire->pin);
    row[2] = Tcl_NewStringObj(isDirection ? directions[wire->direction] : "", -1);
    row[3] = ToObject(&wire->signal);
    Tcl_ListObjAppendElement(NULL, ((WireList*)user)->list, Tcl_NewListObj(4, row));
    return 0;
}

/* {instance pin direction signal} for each pin of each instance. */
static int ListConnections(Tcl_Interp* interp, orn_hdl_model_t model) {
    WireList wires;
    orn_hdl_status_t status;
    wires.list = Tcl_NewListObj(0, NULL);
    status = orn_hdl_model_visit_wires(model, &OnWire, &wires);
    Tcl_SetObjResult(interp, wires.list);
    return status == ORN_HDL_OK ? TCL_OK : SetError(interp, status, NULL);
}

/* The attributes of an object in a flat list of names and values. */
static int ListAttributes(Tcl_Interp* interp, orn_hdl_object_t holder) {
    orn_hdl_cursor_t cursor;
    orn_hdl_object_t object;
    Tcl_Obj* list = Tcl_NewListObj(0, NULL);
    orn_hdl_status_t status = orn_hdl_object_walk(holder, ORN_HDL_ATTRIBUTES, &cursor);
    while (status == ORN_HDL_OK && (status = orn_hdl_cursor_next(&cursor, &object)) == ORN_HDL_OK) {
        orn_hdl_attribute_t attribute;
        status = orn_hdl_attribute_get(object, &attribute);
        if (status == ORN_HDL_OK) {
            Tcl_ListObjAppendElement(NULL, list, ToObject(&attribute.name));
            Tcl_ListObjAppendElement(NULL, list, ToObject(&attribute.value));
        }
    }
    Tcl_SetObjResult(interp, list);
    return status == ORN_HDL_END ? TCL_OK : SetError(interp, status, NULL);
}

static int FindAttributes(Tcl_Interp* interp, orn_hdl_model_t model, Tcl_Obj* kind,
                          const char* name) {
    static const char* const kinds[] = {"component", "instance", "signal", NULL};
    int index = 0;
    orn_hdl_object_t object;
    orn_hdl_status_t status;
    if (Tcl_GetIndexFromObj(interp, kind, kinds, "kind", 0, &index) != TCL_OK) {
        return TCL_ERROR;
    }
    status = index == 0   ? orn_hdl_model_get_component(model, name, &object)
             : index == 1 ? orn_hdl_model_get_instance(model, name, &object)
                          : orn_hdl_model_get_signal(model, name, &object);
    return status == ORN_HDL_OK ? ListAttributes(interp, object) : SetError(interp, status, NULL);
}

/* MODEL write LANGUAGE FILE ?-append? */
static int Write(Tcl_Interp* interp, orn_hdl_model_t model, int count, Tcl_Obj* const words[]) {
    static const char* const options[] = {"-append", NULL};
    int language = 0;
    int option = 0;
    const char* file;
    if (count != 4 && count != 5) {
        Tcl_WrongNumArgs(interp, 2, words, "language file ?-append?");
        return TCL_ERROR;
    }
    if (ToLanguage(interp, words[2], &language) != TCL_OK ||
        (count == 5 &&
         Tcl_GetIndexFromObj(interp, words[4], options, "option", 0, &option) != TCL_OK)) {
        return TCL_ERROR;
    }
    file = ToFileName(interp, words[3]);
    return file == NULL ? TCL_ERROR
                        : FinishModelCall(interp, model,
                                          orn_hdl_model_write(model, language, file, count == 5));
}

/* MODEL text verilog|vhdl|commands */
static int Text(Tcl_Interp* interp, orn_hdl_model_t model, Tcl_Obj* format) {
    static const char* const formats[] = {"verilog", "vhdl", "commands", NULL};
    int index = 0;
    char* text = NULL;
    size_t length = 0;
    orn_hdl_status_t status;
    if (Tcl_GetIndexFromObj(interp, format, formats, "format", 0, &index) != TCL_OK) {
        return TCL_ERROR;
    }
    status = index == 2 ? orn_hdl_model_write_commands_text(model, &text, &length)
                        : orn_hdl_model_write_text(model, index, &text, &length);
    if (status == ORN_HDL_OK) {
        Tcl_SetObjResult(interp, Tcl_NewStringObj(text, (int)length));
        orn_hdl_free(text);
    }
    return FinishModelCall(interp, model, status);
}

/* MODEL read LANGUAGE FILE ?LIBRARY ...? */
static int Read(Tcl_Interp* interp, orn_hdl_model_t model, int count, Tcl_Obj* const words[]) {
    orn_hdl_reader_t reader;
    orn_hdl_error_t error;
    orn_hdl_status_t status;
    int language = 0;
    int result = TCL_OK;
    int i;
    if (count < 4) {
        Tcl_WrongNumArgs(interp, 2, words, "language file ?library ...?");
        return TCL_ERROR;
    }
    if (ToLanguage(interp, words[2], &language) != TCL_OK) {
        return TCL_ERROR;
    }
    for (i = 3; i < count; ++i) {
        if (ToFileName(interp, words[i]) == NULL) {
            return TCL_ERROR;
        }
    }
    status = orn_hdl_reader_create(language, &reader);
    if (status != ORN_HDL_OK) {
        return SetError(interp, status, NULL);
    }
    for (i = 4; i < count && status == ORN_HDL_OK; ++i) {
        status = orn_hdl_reader_add_library(reader, (const char*)Tcl_FSGetNativePath(words[i]));
    }
    if (status == ORN_HDL_OK) {
        status = orn_hdl_reader_read(reader, (const char*)Tcl_FSGetNativePath(words[3]), model);
    }
    if (status != ORN_HDL_OK) {
        const int isTold = orn_hdl_reader_error(reader, &error) == ORN_HDL_OK;
        result = SetError(interp, status, isTold ? &error : NULL);
    }
    orn_hdl_reader_destroy(reader);
    return result;
}

/* MODEL check: {severity rule message} for each finding. */
static int CheckDesign(Tcl_Interp* interp, orn_hdl_model_t model) {
    orn_hdl_findings_t findings;
    orn_hdl_finding_t finding;
    size_t i;
    Tcl_Obj* list;
    const orn_hdl_status_t status = orn_hdl_model_check(model, ORN_HDL_ALL_TARGETS, &findings);
    if (status != ORN_HDL_OK) {
        return SetError(interp, status, NULL);
    }
    list = Tcl_NewListObj(0, NULL);
    for (i = 0; orn_hdl_findings_get(findings, i, &finding) == ORN_HDL_OK; ++i) {
        Tcl_Obj* row[3];
        row[0] = Tcl_NewStringObj(finding.isError ? "error" : "warning", -1);
        row[1] = ToObject(&finding.rule);
        row[2] = ToObject(&finding.message);
        Tcl_ListObjAppendElement(NULL, list, Tcl_NewListObj(3, row));
    }
    orn_hdl_findings_destroy(findings);
    Tcl_SetObjResult(interp, list);
    return TCL_OK;
}

/* MODEL option NAME ?VALUE?: the switches that belong to a write, which no command sets. */
static int Option(Tcl_Interp* interp, orn_hdl_model_t model, int count, Tcl_Obj* const words[]) {
    static const char* const names[] = {"dontcares", "escape", "header", "legal", "verify", NULL};
    static const orn_hdl_option_t options[] = {ORN_HDL_DONT_CARES, ORN_HDL_ESCAPE_NAMES,
                                               ORN_HDL_WRITE_HEADER, ORN_HDL_LEGAL, ORN_HDL_VERIFY};
    int index = 0;
    int value = 0;
    orn_hdl_status_t status;
    if (count != 3 && count != 4) {
        Tcl_WrongNumArgs(interp, 2, words, "name ?value?");
        return TCL_ERROR;
    }
    if (Tcl_GetIndexFromObj(interp, words[2], names, "option", 0, &index) != TCL_OK ||
        (count == 4 && Tcl_GetBooleanFromObj(interp, words[3], &value) != TCL_OK)) {
        return TCL_ERROR;
    }
    if (count == 4) {
        status = orn_hdl_model_set_number(model, options[index], value);
    } else {
        status = orn_hdl_model_get_number(model, options[index], &value);
        Tcl_SetObjResult(interp, Tcl_NewBooleanObj(value));
    }
    return FinishModelCall(interp, model, status);
}

static int Name(Tcl_Interp* interp, orn_hdl_model_t model) {
    orn_hdl_text_t name;
    const orn_hdl_status_t status = orn_hdl_model_get_name(model, &name);
    if (status != ORN_HDL_OK) {
        return SetError(interp, status, NULL);
    }
    Tcl_SetObjResult(interp, ToObject(&name));
    return TCL_OK;
}

enum ModelSubcommand {
    SubAttributes,
    SubCheck,
    SubComponents,
    SubConnections,
    SubDestroy,
    SubExecute,
    SubInstances,
    SubName,
    SubOption,
    SubRead,
    SubRun,
    SubSignals,
    SubText,
    SubUse,
    SubWrite
};

/* How many words a subcommand takes, those of the model and the subcommand included; 0 for any. */
typedef struct SubcommandShape {
    const char* name;
    int words;
    const char* arguments;
} SubcommandShape;

static const SubcommandShape subcommands[] = {{"attributes", 4, "kind name"},
                                              {"check", 2, NULL},
                                              {"components", 2, NULL},
                                              {"connections", 2, NULL},
                                              {"destroy", 2, NULL},
                                              {"execute", 3, "line"},
                                              {"instances", 2, NULL},
                                              {"name", 2, NULL},
                                              {"option", 0, NULL},
                                              {"read", 0, NULL},
                                              {"run", 0, NULL},
                                              {"signals", 2, NULL},
                                              {"text", 3, "format"},
                                              {"use", 2, NULL},
                                              {"write", 0, NULL},
                                              {NULL, 0, NULL}};

static int RunSubcommand(ModelCommand* command, Tcl_Interp* interp, int index, int count,
                         Tcl_Obj* const words[]) {
    const orn_hdl_model_t model = command->model;
    switch (index) {
    case SubAttributes:
        return FindAttributes(interp, model, words[2], Tcl_GetString(words[3]));
    case SubCheck:
        return CheckDesign(interp, model);
    case SubComponents:
        return ListNames(interp, model, ORN_HDL_COMPONENTS);
    case SubConnections:
        return ListConnections(interp, model);
    case SubDestroy:
        return Tcl_DeleteCommand(interp, Tcl_GetString(words[0])) == 0 ? TCL_OK : TCL_ERROR;
    case SubExecute:
        return FinishModelCall(interp, model,
                               orn_hdl_model_execute(model, Tcl_GetString(words[2])));
    case SubInstances:
        return ListNames(interp, model, ORN_HDL_INSTANCES);
    case SubName:
        return Name(interp, model);
    case SubOption:
        return Option(interp, model, count, words);
    case SubRead:
        return Read(interp, model, count, words);
    case SubRun:
        if (count != 3 && count != 4) {
            Tcl_WrongNumArgs(interp, 2, words, "file ?progress?");
            return TCL_ERROR;
        }
        return Replay(interp, model, words[2], count == 4 ? words[3] : NULL);
    case SubSignals:
        return ListNames(interp, model, ORN_HDL_SIGNALS);
    case SubText:
        return Text(interp, model, words[2]);
    case SubUse:
        command->state->current = model;
        return TCL_OK;
    default:
        return Write(interp, model, count, words);
    }
}

static int ModelCommandCall(ClientData data, Tcl_Interp* interp, int count,
                            Tcl_Obj* const words[]) {
    ModelCommand* command = (ModelCommand*)data;
    PackageState* state = command->state;
    int index = 0;
    int result;
    if (count < 2) {
        Tcl_WrongNumArgs(interp, 1, words, "subcommand ?argument ...?");
        return TCL_ERROR;
    }
    if (Tcl_GetIndexFromObjStruct(interp, words[1], subcommands, sizeof(subcommands[0]),
                                  "subcommand", 0, &index) != TCL_OK) {
        return TCL_ERROR;
    }
    if (subcommands[index].words != 0 && subcommands[index].words != count) {
        Tcl_WrongNumArgs(interp, 2, words, subcommands[index].arguments);
        return TCL_ERROR;
    }
    /* A progress script may delete the command or the interpreter. */
    Tcl_Preserve((ClientData)state);
    Tcl_Preserve((ClientData)command);
    result = RunSubcommand(command, interp, index, count, words);
    Tcl_Release((ClientData)command);
    Tcl_Release((ClientData)state);
    return result;
}

/* ---------------------------------------------------------------------------------------------- */
/* Lifetime                                                                                       */

static void FreeModelCommand(char* block) {
    ModelCommand* command = (ModelCommand*)block;
    PackageState* state = command->state;
    orn_hdl_model_destroy(command->model);
    ckfree(block);
    Tcl_Release((ClientData)state);
}

static void DeleteModelCommand(ClientData data) {
    Tcl_EventuallyFree(data, &FreeModelCommand);
}

static void FreeState(char* block) {
    orn_hdl_engine_destroy(((PackageState*)block)->engine);
    ckfree(block);
}

static void DeleteState(ClientData data, Tcl_Interp* interp) {
    (void)interp;
    Tcl_EventuallyFree(data, &FreeState);
}

/* Gives a model a Tcl command, whose name becomes the result. */
static int MakeModelCommand(PackageState* state, Tcl_Interp* interp, orn_hdl_model_t model) {
    char name[64];
    ModelCommand* command = (ModelCommand*)ckalloc(sizeof(ModelCommand));
    do {
        snprintf(name, sizeof(name), "::orn_hdl::model%lu", ++state->lastNumber);
    } while (Tcl_FindCommand(interp, name, NULL, TCL_GLOBAL_ONLY) != NULL);
    command->state = state;
    command->model = model;
    Tcl_Preserve((ClientData)state);
    Tcl_CreateObjCommand(interp, name, &ModelCommandCall, command, &DeleteModelCommand);
    state->current = model;
    Tcl_SetObjResult(interp, Tcl_NewStringObj(name, -1));
    return TCL_OK;
}

/* ---------------------------------------------------------------------------------------------- */
/* The commands of the package                                                                    */

/* orn_hdl::create NAME ?SOURCE? */
static int CreateCall(ClientData data, Tcl_Interp* interp, int count, Tcl_Obj* const words[]) {
    PackageState* state = (PackageState*)data;
    orn_hdl_model_t model;
    orn_hdl_status_t status;
    if (count != 2 && count != 3) {
        Tcl_WrongNumArgs(interp, 1, words, "name ?source?");
        return TCL_ERROR;
    }
    status = orn_hdl_engine_add_model(state->engine, Tcl_GetString(words[1]),
                                      count == 3 ? Tcl_GetString(words[2]) : "", &model);
    return status == ORN_HDL_OK ? MakeModelCommand(state, interp, model)
                                : FinishEngineCall(interp, state->engine, status);
}

/* orn_hdl::execute LINE */
static int ExecuteCall(ClientData data, Tcl_Interp* interp, int count, Tcl_Obj* const words[]) {
    PackageState* state = (PackageState*)data;
    orn_hdl_status_t status;
    if (count != 2) {
        Tcl_WrongNumArgs(interp, 1, words, "line");
        return TCL_ERROR;
    }
    status = orn_hdl_model_execute(state->current, Tcl_GetString(words[1]));
    if (status == ORN_HDL_NULL_HANDLE || status == ORN_HDL_DEAD_HANDLE) {
        Tcl_SetObjResult(interp, Tcl_NewStringObj("there is no current model", -1));
        Tcl_SetErrorCode(interp, "ORN_HDL", NameOfStatus(status), NULL);
        return TCL_ERROR;
    }
    return FinishModelCall(interp, state->current, status);
}

/* The name of a file without its folder and its extension. */
static Tcl_Obj* StemOf(Tcl_Obj* file) {
    const char* text = Tcl_GetString(file);
    const char* slash = strrchr(text, '/');
    const char* tail = slash == NULL ? text : slash + 1;
    const char* point = strrchr(tail, '.');
    return Tcl_NewStringObj(tail, point == NULL || point == tail ? -1 : (int)(point - tail));
}

/* orn_hdl::run FILE ?PROGRESS? */
static int RunCall(ClientData data, Tcl_Interp* interp, int count, Tcl_Obj* const words[]) {
    PackageState* state = (PackageState*)data;
    orn_hdl_model_t model;
    orn_hdl_status_t status;
    Tcl_Obj* name;
    int result;
    if (count != 2 && count != 3) {
        Tcl_WrongNumArgs(interp, 1, words, "file ?progress?");
        return TCL_ERROR;
    }
    name = StemOf(words[1]);
    Tcl_IncrRefCount(name);
    status = orn_hdl_engine_add_model(state->engine, Tcl_GetString(name), Tcl_GetString(words[1]),
                                      &model);
    Tcl_DecrRefCount(name);
    if (status != ORN_HDL_OK) {
        return FinishEngineCall(interp, state->engine, status);
    }
    Tcl_Preserve((ClientData)state);
    result = Replay(interp, model, words[1], count == 3 ? words[2] : NULL);
    if (result == TCL_OK && !Tcl_InterpDeleted(interp)) {
        result = MakeModelCommand(state, interp, model);
    } else {
        orn_hdl_model_destroy(model);
    }
    Tcl_Release((ClientData)state);
    return result;
}

/* orn_hdl::version */
static int VersionCall(ClientData data, Tcl_Interp* interp, int count, Tcl_Obj* const words[]) {
    (void)data;
    if (count != 1) {
        Tcl_WrongNumArgs(interp, 1, words, NULL);
        return TCL_ERROR;
    }
    Tcl_SetObjResult(interp, Tcl_NewStringObj(orn_hdl_version(), -1));
    return TCL_OK;
}

int DLLEXPORT Orn_hdl_Init(Tcl_Interp* interp);

int DLLEXPORT Orn_hdl_Init(Tcl_Interp* interp) {
    PackageState* state;
    orn_hdl_engine_t engine;
    orn_hdl_status_t status;
    if (Tcl_InitStubs(interp, "8.6", 0) == NULL) {
        return TCL_ERROR;
    }
    status = orn_hdl_engine_create(&engine);
    if (status != ORN_HDL_OK) {
        return SetError(interp, status, NULL);
    }
    state = (PackageState*)ckalloc(sizeof(PackageState));
    memset(state, 0, sizeof(*state));
    state->engine = engine;
    Tcl_SetAssocData(interp, ASSOCIATED_KEY, &DeleteState, state);
    Tcl_CreateObjCommand(interp, "::orn_hdl::create", &CreateCall, state, NULL);
    Tcl_CreateObjCommand(interp, "::orn_hdl::execute", &ExecuteCall, state, NULL);
    Tcl_CreateObjCommand(interp, "::orn_hdl::run", &RunCall, state, NULL);
    Tcl_CreateObjCommand(interp, "::orn_hdl::version", &VersionCall, state, NULL);
    return Tcl_PkgProvide(interp, "orn_hdl", orn_hdl_version());
}
