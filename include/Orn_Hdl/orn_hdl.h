/**
 * \file
 * The library from C: engines, models, reading a design, writing, checking and reading netlists.
 *
 * The header is C99 and C++. Functions and types begin with `orn_hdl_`, types end in `_t`, and
 * constants begin with `ORN_HDL_`.
 *
 * **Statuses.** Every function that can fail returns an `orn_hdl_status_t`. No exception leaves a
 * function. `orn_hdl_engine_error`, `orn_hdl_model_error` and `orn_hdl_reader_error` tell of the
 * last failed call that could change what the handle stands for. Calls that only look at something
 * leave this alone: their status says everything. A result is written only when the status is
 * `ORN_HDL_OK`, unless its function says otherwise.
 *
 * **Handles.** A handle is a small value that is copied freely; one that is all zeros is the null
 * handle. The library checks each handle that it gets. The handle of something that was destroyed
 * gives `ORN_HDL_DEAD_HANDLE`, and never the handle of something else.
 *
 * **Texts.** A text that goes in ends in NUL, and is copied where it is kept. Null is read as "",
 * except where the function says otherwise. A text that comes out has a length and a NUL behind it.
 * It belongs to the library and is valid until the same thread calls the next function with a
 * result that has texts. Texts that can be large are allocated instead: the caller frees them with
 * `orn_hdl_free`.
 *
 * **Threads.** One engine and its models belong to one thread at a time. Any number of engines may
 * work in parallel, and any number of threads may read one model while nobody changes it.
 *
 * **Callbacks.** A callback may look at any model. Calls that change a model, or destroy a handle,
 * give `ORN_HDL_BUSY` while a callback about it runs. A callback must return to its caller: it must
 * not throw, and not jump out with `longjmp`.
 *
 * \code
 * orn_hdl_engine_t engine;
 * orn_hdl_model_t model;
 * orn_hdl_engine_create(&engine);
 * orn_hdl_engine_add_model(engine, "top", "", &model);
 * orn_hdl_model_execute(model, "ADD PORT A input");
 * orn_hdl_model_write(model, ORN_HDL_VERILOG, "top.v", 0);
 * orn_hdl_engine_destroy(engine);
 * \endcode
 */
#ifndef ORN_HDL_C_INTERFACE_H
#define ORN_HDL_C_INTERFACE_H

#include <stddef.h>
#include <stdint.h>

/** \def ORN_HDL_C_API
 * Marks the declaration of an exported function. */
#if defined(ORN_HDL_STATIC)
#define ORN_HDL_C_API
#elif defined(_WIN32)
#if defined(ORN_HDL_BUILD)
#define ORN_HDL_C_API __declspec(dllexport)
#else
#define ORN_HDL_C_API __declspec(dllimport)
#endif
#else
#define ORN_HDL_C_API __attribute__((visibility("default")))
#endif

#ifdef __cplusplus
extern "C" {
#endif

/** The outcome of a call, one of the constants `ORN_HDL_OK` to `ORN_HDL_UNEXPECTED`. */
typedef int32_t orn_hdl_status_t;

enum {
    /** The call did what it says. */
    ORN_HDL_OK = 0,
    /** There is no further element. */
    ORN_HDL_END = 1,
    /** A handle is the null handle. */
    ORN_HDL_NULL_HANDLE = 2,
    /** What a handle stood for does not exist any more, or never did. */
    ORN_HDL_DEAD_HANDLE = 3,
    /** The function does not work with what the handle stands for. */
    ORN_HDL_WRONG_KIND = 4,
    /** An argument is not allowed, such as a null pointer for a result. */
    ORN_HDL_INVALID_ARGUMENT = 5,
    /** There is nothing of that name. */
    ORN_HDL_NOT_FOUND = 6,
    /** The engine has a model of that name. */
    ORN_HDL_EXISTS = 7,
    /** The library refuses; the text of the error is that of its exception. */
    ORN_HDL_FAILED = 8,
    /** A file cannot be read or written. */
    ORN_HDL_FILE = 9,
    /** A netlist does not mean what the design does; the text of the error tells of it. */
    ORN_HDL_DIFFERS = 10,
    /** A callback about the model, engine or reader is running. */
    ORN_HDL_BUSY = 11,
    /** A callback has asked to stop. */
    ORN_HDL_STOPPED = 12,
    /** Memory is exhausted. The handles are still good. */
    ORN_HDL_NO_MEMORY = 13,
    /** Something that this list does not foresee; the text of the error tells of it. */
    ORN_HDL_UNEXPECTED = 14
};

/** A text that the library hands out; see the rule about texts above. */
typedef struct orn_hdl_text_t {
    /** The characters and a NUL behind them; never null in a result. */
    const char* data;
    /** How many characters there are, without the NUL. */
    size_t length;
} orn_hdl_text_t;

/** An engine: models by name. */
typedef struct orn_hdl_engine_t {
    /** For the library alone; 0 in the null handle. */
    uint64_t id;
} orn_hdl_engine_t;

/** A model: one design and its options. It belongs to its engine. */
typedef struct orn_hdl_model_t {
    /** For the library alone; 0 in the null handle. */
    uint64_t id;
} orn_hdl_model_t;

/** An object of a design: its netlist, a component, an instance, a signal, a pin or an attribute.
 * The handle lives until its model, or any object of the model is destroyed: by
 * `orn_hdl_object_remove`, by reading a netlist into the model, or when a bus gets a wider range
 * than it had. Get the object again by its name then. */
typedef struct orn_hdl_object_t {
    /** For the library alone; all three are 0 in the null handle. */
    uint64_t model;
    /** For the library alone. */
    uint64_t place;
    /** For the library alone. */
    uint64_t stamp;
} orn_hdl_object_t;

/** A position in a list of objects. It lives as long as a handle of the list's owner does. */
typedef struct orn_hdl_cursor_t {
    /** Whose list it is. */
    orn_hdl_object_t owner;
    /** Which list it is, such as `ORN_HDL_PINS`. */
    int32_t list;
    /** The index of the next element. */
    int32_t index;
} orn_hdl_cursor_t;

/** A reader of netlists. It belongs to the caller. */
typedef struct orn_hdl_reader_t {
    /** For the library alone; 0 in the null handle. */
    uint64_t id;
} orn_hdl_reader_t;

/** What a check or a proof has found. It belongs to the caller and is independent of the model. */
typedef struct orn_hdl_findings_t {
    /** For the library alone; 0 in the null handle. */
    uint64_t id;
} orn_hdl_findings_t;

/** A language, one of `ORN_HDL_VERILOG` and `ORN_HDL_VHDL`. */
typedef int32_t orn_hdl_language_t;

enum {
    /** Verilog. */
    ORN_HDL_VERILOG = 0,
    /** VHDL. */
    ORN_HDL_VHDL = 1
};

/** The last failure of a handle. */
typedef struct orn_hdl_error_t {
    /** The status of the call; `ORN_HDL_OK` when none has failed. */
    orn_hdl_status_t status;
    /** What happened: the text of the library's exception with its line feed, or that of
     * `orn_hdl_status_text`. Empty when nothing has failed. */
    orn_hdl_text_t text;
    /** The command file with the line that failed; empty for none. */
    orn_hdl_text_t file;
    /** The number of the line that failed, from 1; 0 for none. */
    uint64_t line;
} orn_hdl_error_t;

/* ---------------------------------------------------------------------------------------------- */
/* The library                                                                                    */

/** The version of the library, such as "1.0.0"; valid until the program ends. */
ORN_HDL_C_API const char* orn_hdl_version(void);
/** What a status means, in a few words; valid until the program ends. */
ORN_HDL_C_API const char* orn_hdl_status_text(orn_hdl_status_t status);
/** Frees a text that a function has allocated. Null is ignored. */
ORN_HDL_C_API void orn_hdl_free(char* text);
/** Tells whether a word is reserved in a language: in VHDL in any letter case.
 * \param reserved receives 1 or 0. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_is_keyword(orn_hdl_language_t language, const char* word,
                                                  int* reserved);

/** A phrase of the command language. Its texts are valid until the program ends. */
typedef struct orn_hdl_command_t {
    /** The words that select the command. */
    const char* phrase;
    /** The arguments behind them: `<required>`, `[optional]`, "..." for several words. */
    const char* arguments;
    /** What the command does, in one line. */
    const char* help;
} orn_hdl_command_t;

/** A phrase of the command language, by its index from 0. \return `ORN_HDL_END` behind the last. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_get_command(size_t index, orn_hdl_command_t* command);

/* ---------------------------------------------------------------------------------------------- */
/* Engines                                                                                        */

/** Makes an engine without models, which the caller destroys with `orn_hdl_engine_destroy`. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_create(orn_hdl_engine_t* engine);
/** Destroys an engine with its models; the handles of all of them are dead then. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_destroy(orn_hdl_engine_t engine);
/** Makes a model, which does not become the current one.
 * \param sourceFile the file from which the design comes; it is only remembered.
 * \param model receives the handle; may be null.
 * \return `ORN_HDL_EXISTS`, without a change, if the engine has a model of that name. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_add_model(orn_hdl_engine_t engine, const char* name,
                                                        const char* sourceFile,
                                                        orn_hdl_model_t* model);
/** The model of that name. \return `ORN_HDL_NOT_FOUND` if there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_get_model(orn_hdl_engine_t engine, const char* name,
                                                        orn_hdl_model_t* model);
/** Makes a model the current one. \return `ORN_HDL_NOT_FOUND` if there is none of that name. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_use_model(orn_hdl_engine_t engine, const char* name);
/** Destroys a model. \return `ORN_HDL_NOT_FOUND` if there is none of that name. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_remove_model(orn_hdl_engine_t engine,
                                                           const char* name);
/** Destroys a model, whatever its name is by now. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_destroy(orn_hdl_model_t model);
/** Runs a command line on the current model. It fails with "Missing Model." if there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_execute(orn_hdl_engine_t engine, const char* line);
/** Replays a command file on a model, as `orn_hdl_model_replay` does. The model is made if there is
 * none of that name. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_replay(orn_hdl_engine_t engine, const char* model,
                                                     const char* fileName);
/** The last failed call with this engine, those that are made with its models not included. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_engine_error(orn_hdl_engine_t engine,
                                                    orn_hdl_error_t* error);

/* ---------------------------------------------------------------------------------------------- */
/* Models: command lines and files                                                                */

/** Called while a file is replayed, every 4096 lines.
 * \param lines how many lines have been carried out.
 * \param bytes how many bytes these take in the file.
 * \return 0 to go on. */
typedef int (*orn_hdl_progress_t)(void* user, uint64_t lines, uint64_t bytes);
/** Called for a line of a file that has failed.
 * \param error valid during the call, its texts included.
 * \return 0 to go on with the next line. */
typedef int (*orn_hdl_failure_t)(void* user, const orn_hdl_error_t* error);

/** Runs a command line. An empty one does nothing. A file that a command cannot write gives
 * `ORN_HDL_FILE`. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_execute(orn_hdl_model_t model, const char* line);
/** Runs the lines of a text, up to the first that fails, whose number the error has.
 * \param lines the text, which needs no NUL behind it; null with the length 0.
 * \param length how many characters it has. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_execute_lines(orn_hdl_model_t model, const char* lines,
                                                           size_t length);
/** Replays a command file and clears the modified flag. When a line fails, the lines before it stay
 * done, and the error has the file and the number of the line.
 * \param progress told of the progress; null for nobody. When it asks to stop, the replay ends with
 *        `ORN_HDL_STOPPED`.
 * \param failure told of each line that fails; null to end at the first.
 * \param user handed to both.
 * \return the status of the last line that failed, `ORN_HDL_OK` if none did, and `ORN_HDL_FILE` if
 *         the file cannot be read. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_replay(orn_hdl_model_t model, const char* fileName,
                                                    orn_hdl_progress_t progress,
                                                    orn_hdl_failure_t failure, void* user);
/** The last failed call with this model. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_error(orn_hdl_model_t model, orn_hdl_error_t* error);

/** Decides whether a write command may write a file.
 * \return null or "" if it may, otherwise why it may not; the text is copied. */
typedef const char* (*orn_hdl_guard_t)(void* user, const char* fileName);
/** Sets who is asked before a file is written by a command, and by `orn_hdl_model_write`.
 * \param guard null for nobody, as at first. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_guard(orn_hdl_model_t model, orn_hdl_guard_t guard,
                                                       void* user);
/** How the last write ended that a command made; a line that is executed later clears the error.
 * \param error receives the system's error number, 0 when every byte was written; may be null.
 * \param leftover receives how many bytes stand at the end of a file although appending has failed;
 *        may be null.
 * \param fileName receives the name of the file; may be null. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_last_write(orn_hdl_model_t model, int* error,
                                                            uint64_t* leftover,
                                                            orn_hdl_text_t* fileName);
/** How many done commands the model keeps. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_done_count(orn_hdl_model_t model, size_t* count);
/** Frees the done commands. The design stays as it is. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_clear_done(orn_hdl_model_t model);

/* ---------------------------------------------------------------------------------------------- */
/* Models: state                                                                                  */

/** The name of the model, which is that of its netlist. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_name(orn_hdl_model_t model, orn_hdl_text_t* name);
/** Renames the netlist; null gives "HDL_NETLIST". */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_name(orn_hdl_model_t model, const char* name);
/** The file from which the design comes; empty when it is not known. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_source_file(orn_hdl_model_t model,
                                                             orn_hdl_text_t* name);
/** Remembers from which file the design comes. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_source_file(orn_hdl_model_t model,
                                                             const char* name);
/** Whether the design has changed since the flag was cleared. \param modified receives 1 or 0. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_is_modified(orn_hdl_model_t model, int* modified);
/** Sets or clears the modified flag. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_modified(orn_hdl_model_t model, int modified);

/* ---------------------------------------------------------------------------------------------- */
/* Models: operations by name. A check that fails gives ORN_HDL_FAILED and changes nothing.       */

/** Declares a component without pins. Components, instances and signals share one name space. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_component(orn_hdl_model_t model, const char* name);
/** Appends a pin to a component. Instances that are there already do not get it.
 * \param direction "input", "output", "inout" or "bidirectional", or the beginning of one.
 * \param defaultValue a bit-vector literal; null and "" for none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_pin(orn_hdl_model_t model, const char* component,
                                                     const char* name, const char* direction,
                                                     const char* defaultValue);
/** Places a component: the instance gets its own copies of the component's pins, all open. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_instance(orn_hdl_model_t model, const char* name,
                                                          const char* component);
/** Places a component several times, up to the first failure.
 * \param done receives how many instances were added, whatever the status; may be null. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_instances(orn_hdl_model_t model,
                                                           const char* component,
                                                           const char* const* names, size_t count,
                                                           size_t* done);
/** Declares a signal, or a bus when the name has a range. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_signal(orn_hdl_model_t model, const char* name);
/** Declares a port: a signal, or a bus when the name has a range, with a direction.
 * \param direction as `orn_hdl_model_add_pin` takes it. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_port(orn_hdl_model_t model, const char* name,
                                                      const char* direction);
/** The net of one bit of a bus, which is made on its first use. The index has to be in the range of
 * the bus.
 * \param bus the name of the bus, with or without its range. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_bit(orn_hdl_model_t model, const char* bus, int index,
                                                 orn_hdl_object_t* bit);
/** Renames a component. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_rename_component(orn_hdl_model_t model,
                                                              const char* name,
                                                              const char* newName);
/** Renames an instance. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_rename_instance(orn_hdl_model_t model,
                                                             const char* name, const char* newName);
/** Renames a scalar signal, or a bus with its slices and bits. A bus keeps its range, which the new
 * name has to have too. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_rename_signal(orn_hdl_model_t model, const char* name,
                                                           const char* newName);
/** Connects a pin to a signal, which is declared on its first use. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_connect(orn_hdl_model_t model, const char* signal,
                                                     const char* instance, const char* pin);

/** A connection of a pin to a signal. */
typedef struct orn_hdl_connection_t {
    /** The name of the signal. */
    const char* signal;
    /** The name of the instance. */
    const char* instance;
    /** The name of its pin. */
    const char* pin;
} orn_hdl_connection_t;

/** Makes several connections, up to the first failure.
 * \param done receives how many were made, whatever the status; may be null. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_connect_many(orn_hdl_model_t model,
                                                          const orn_hdl_connection_t* connections,
                                                          size_t count, size_t* done);
/** Makes the second signal an alias of the first; both are declared on their first use. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_connect_signals(orn_hdl_model_t model,
                                                             const char* first, const char* second);
/** Ties a signal to a constant; the signal is declared on its first use.
 * \param value digits, or LENGTH:BASE:DIGITS such as "8:H:A5". */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_assign_signal(orn_hdl_model_t model,
                                                           const char* signal, const char* value);
/** Connects a pin to a signal of its own that carries the constant.
 * \param value digits, or LENGTH:BASE:DIGITS such as "8:H:A5". */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_assign_pin(orn_hdl_model_t model, const char* instance,
                                                        const char* pin, const char* value);

/** Whose attribute or comment is meant, one of the constants `ORN_HDL_OF_MODULE` to
 * `ORN_HDL_OF_INSTANCE_PIN`. */
typedef int32_t orn_hdl_holder_t;

enum {
    /** The module's; both names are ignored. */
    ORN_HDL_OF_MODULE = 0,
    /** A component's; the name of a pin is ignored. */
    ORN_HDL_OF_COMPONENT = 1,
    /** An instance's; the name of a pin is ignored. */
    ORN_HDL_OF_INSTANCE = 2,
    /** A signal's; the name of a pin is ignored. */
    ORN_HDL_OF_SIGNAL = 3,
    /** A pin's of a component. */
    ORN_HDL_OF_COMPONENT_PIN = 4,
    /** A pin's of an instance. */
    ORN_HDL_OF_INSTANCE_PIN = 5
};

/** Adds an attribute, or gives one that is present another value.
 * \param name the attribute; null is refused.
 * \param type "String", "Integer", "Float", "Boolean", "Bit", "BitVector" or "User"; null means
 *        "String". */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_attribute(orn_hdl_model_t model,
                                                           orn_hdl_holder_t holder,
                                                           const char* owner, const char* pin,
                                                           const char* name, const char* value,
                                                           const char* type);
/** Sets the value of an attribute. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_attribute(orn_hdl_model_t model,
                                                           orn_hdl_holder_t holder,
                                                           const char* owner, const char* pin,
                                                           const char* name, const char* value);
/** Sets the generic option of an attribute: "NONE", "SYN" or "NOSYN". */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_generic(orn_hdl_model_t model,
                                                         orn_hdl_holder_t holder, const char* owner,
                                                         const char* pin, const char* name,
                                                         const char* value);
/** Sets the synthesis option of an attribute: "NONE", "ASSIGN" or "ASSIGNNODEC". */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_synthesis(orn_hdl_model_t model,
                                                           orn_hdl_holder_t holder,
                                                           const char* owner, const char* pin,
                                                           const char* name, const char* value);
/** Names the type of an attribute, which has to be of the type "User". */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_user_type(orn_hdl_model_t model,
                                                           orn_hdl_holder_t holder,
                                                           const char* owner, const char* pin,
                                                           const char* name, const char* type);
/** Adds a line to a comment, of the module to its notes. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_add_comment(orn_hdl_model_t model,
                                                         orn_hdl_holder_t holder, const char* owner,
                                                         const char* pin, const char* text);

/* ---------------------------------------------------------------------------------------------- */
/* Reading a design                                                                               */

/** The netlist as an object: the owner of all others, with attributes and notes of its own. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_netlist(orn_hdl_model_t model,
                                                         orn_hdl_object_t* netlist);
/** The component of that name. \return `ORN_HDL_NOT_FOUND` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_component(orn_hdl_model_t model, const char* name,
                                                           orn_hdl_object_t* component);
/** The instance of that name. \return `ORN_HDL_NOT_FOUND` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_instance(orn_hdl_model_t model, const char* name,
                                                          orn_hdl_object_t* instance);
/** The signal of that name. \return `ORN_HDL_NOT_FOUND` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_signal(orn_hdl_model_t model, const char* name,
                                                        orn_hdl_object_t* signal);
/** The pin of that name of a component or an instance.
 * \return `ORN_HDL_NOT_FOUND` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_pin(orn_hdl_object_t owner, const char* name,
                                                      orn_hdl_object_t* pin);
/** The attribute of that name. \return `ORN_HDL_NOT_FOUND` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_attribute(orn_hdl_object_t owner,
                                                            const char* name,
                                                            orn_hdl_object_t* attribute);

enum {
    /** The components of a netlist. */
    ORN_HDL_COMPONENTS = 0,
    /** The instances of a netlist. */
    ORN_HDL_INSTANCES = 1,
    /** The signals of a netlist, buses and their parts included. */
    ORN_HDL_SIGNALS = 2,
    /** The pins of a component or an instance, or those that a signal lists. */
    ORN_HDL_PINS = 3,
    /** The attributes of any object that is not an attribute itself. */
    ORN_HDL_ATTRIBUTES = 4,
    /** The slices and bits of a bus. */
    ORN_HDL_PARTS = 5,
    /** The members of a compound, leftmost first. */
    ORN_HDL_MEMBERS = 6,
    /** The aliases of a signal. */
    ORN_HDL_ALIASES = 7
};

/** Begins a walk over a list. Objects that are added during the walk are visited; a write sorts the
 * lists, so that a walk should not go on behind one.
 * \param list one of the constants `ORN_HDL_COMPONENTS` to `ORN_HDL_ALIASES`.
 * \return `ORN_HDL_WRONG_KIND` when the object has no such list. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_walk(orn_hdl_object_t owner, int32_t list,
                                                   orn_hdl_cursor_t* cursor);
/** The next object of a walk. \return `ORN_HDL_END` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_cursor_next(orn_hdl_cursor_t* cursor,
                                                   orn_hdl_object_t* object);
/** The next objects of a walk.
 * \param objects receives up to `capacity` of them.
 * \param count receives how many these are; fewer than `capacity` at the end.
 * \return `ORN_HDL_END` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_cursor_next_many(orn_hdl_cursor_t* cursor,
                                                        orn_hdl_object_t* objects, size_t capacity,
                                                        size_t* count);

enum {
    /** A netlist. */
    ORN_HDL_KIND_NETLIST = 1,
    /** A component. */
    ORN_HDL_KIND_COMPONENT = 2,
    /** An instance. */
    ORN_HDL_KIND_INSTANCE = 3,
    /** A pin of one bit. */
    ORN_HDL_KIND_SCALAR_PIN = 4,
    /** A pin with a range. */
    ORN_HDL_KIND_BUS_PIN = 5,
    /** A pin whose name has one index. */
    ORN_HDL_KIND_BIT_PIN = 6,
    /** A signal of one bit. */
    ORN_HDL_KIND_SCALAR = 7,
    /** A bus. */
    ORN_HDL_KIND_BUS = 8,
    /** A slice of a bus. */
    ORN_HDL_KIND_SLICE = 9,
    /** A bit of a bus. */
    ORN_HDL_KIND_BIT = 10,
    /** A concatenation of signals. */
    ORN_HDL_KIND_COMPOUND = 11,
    /** An attribute. */
    ORN_HDL_KIND_ATTRIBUTE = 12
};

enum {
    /** The object has no direction: it is no pin and no port. */
    ORN_HDL_NO_DIRECTION = -1,
    /** An input. */
    ORN_HDL_INPUT = 0,
    /** An output. */
    ORN_HDL_OUTPUT = 1,
    /** Bidirectional. */
    ORN_HDL_BIDIRECTIONAL = 2
};

/** What kind of object it is, one of the constants `ORN_HDL_KIND_NETLIST` to
 * `ORN_HDL_KIND_ATTRIBUTE`. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_kind(orn_hdl_object_t object, int32_t* kind);
/** The name of an object, with its range or index. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_name(orn_hdl_object_t object,
                                                       orn_hdl_text_t* name);
/** The comment of an object, every line with its line feed; a netlist's notes. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_comment(orn_hdl_object_t object,
                                                          orn_hdl_text_t* comment);
/** The direction of a pin or a signal, one of `ORN_HDL_NO_DIRECTION` to `ORN_HDL_BIDIRECTIONAL`. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_direction(orn_hdl_object_t object,
                                                            int32_t* direction);
/** The number of bits of a pin or a signal; 0 when a range does not parse. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_width(orn_hdl_object_t object, int32_t* width);
/** The range of a bus, a slice or a bus pin, or the index of a bit twice.
 * \param base receives the name before the range; may be null. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_range(orn_hdl_object_t object,
                                                        orn_hdl_text_t* base, int32_t* left,
                                                        int32_t* right);

/** The value of a signal or a pin: digits with a base and a length. */
typedef struct orn_hdl_constant_t {
    /** The digits; empty when there is no value. */
    orn_hdl_text_t digits;
    /** 2, 8 or 16. */
    int32_t base;
    /** The length in bits; 1 when none was given. */
    int32_t length;
    /** Whether base and length were given. */
    int32_t isSized;
} orn_hdl_constant_t;

/** The constant that a signal is tied to, or the default value of a pin. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_get_constant(orn_hdl_object_t object,
                                                           orn_hdl_constant_t* constant);
/** The component of an instance.
 * \return `ORN_HDL_NOT_FOUND` when it has none, or none any more. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_instance_get_component(orn_hdl_object_t instance,
                                                              orn_hdl_object_t* component);
/** The signal at a pin. \return `ORN_HDL_NOT_FOUND` when the pin is open. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_pin_get_signal(orn_hdl_object_t pin,
                                                      orn_hdl_object_t* signal);
/** The bus of a slice or a bit. \return `ORN_HDL_NOT_FOUND` when it has none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_part_get_bus(orn_hdl_object_t part, orn_hdl_object_t* bus);
/** The dummy signal that a write has put in the place of a port.
 * \return `ORN_HDL_NOT_FOUND` when there is none. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_signal_get_dummy(orn_hdl_object_t signal,
                                                        orn_hdl_object_t* dummy);

/** An attribute. */
typedef struct orn_hdl_attribute_t {
    /** The name. */
    orn_hdl_text_t name;
    /** The name of the type, such as "BitVector". */
    orn_hdl_text_t type;
    /** The value as a text. */
    orn_hdl_text_t value;
    /** The generic option: "NONE", "SYN" or "NOSYN". */
    orn_hdl_text_t generic;
    /** The synthesis option: "NONE", "ASSIGN" or "ASSIGNNODEC". */
    orn_hdl_text_t synthesis;
    /** The name of the user's type; empty for other types. */
    orn_hdl_text_t userType;
    /** The constant for a value of the type "BitVector"; without digits for other types. */
    orn_hdl_constant_t constant;
} orn_hdl_attribute_t;

/** Everything about an attribute. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_attribute_get(orn_hdl_object_t attribute,
                                                     orn_hdl_attribute_t* result);

/** A pin of an instance with what it is wired to. */
typedef struct orn_hdl_wire_t {
    /** The name of the pin. */
    orn_hdl_text_t pin;
    /** The name of the signal; empty for an open pin. */
    orn_hdl_text_t signal;
    /** The direction of the pin. */
    int32_t direction;
} orn_hdl_wire_t;

/** All pins of an instance with their signals, in one call.
 * \param wires receives the first `capacity` of them; may be null with the capacity 0.
 * \param count receives how many pins there are. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_instance_get_wires(orn_hdl_object_t instance,
                                                          orn_hdl_wire_t* wires, size_t capacity,
                                                          size_t* count);
/** Called for each pin of each instance.
 * \param wire valid during the call, its texts included; so is the name of the instance.
 * \return 0 to go on. */
typedef int (*orn_hdl_wire_visitor_t)(void* user, const orn_hdl_text_t* instance,
                                      const orn_hdl_wire_t* wire);
/** Visits all pins of all instances, in their order.
 * \return `ORN_HDL_STOPPED` when the visitor has asked to stop. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_visit_wires(orn_hdl_model_t model,
                                                         orn_hdl_wire_visitor_t visitor,
                                                         void* user);

/** Destroys a component, an instance, a signal, an attribute, or a pin. With a pin of a component
 * go those of its instances, with a component nothing else: its instances have none then. A netlist
 * cannot be destroyed. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_object_remove(orn_hdl_object_t object);

/* ---------------------------------------------------------------------------------------------- */
/* Options                                                                                        */

/** An option of a model. */
typedef int32_t orn_hdl_option_t;

enum {
    /** Number: VHDL without the configuration. */
    ORN_HDL_VHDL_SUPPRESS_CONFIGURATION = 0,
    /** Number: set by the command FLATTEN BUS; it has no effect on the output. */
    ORN_HDL_VHDL_FLATTEN_BUS = 1,
    /** Number: VHDL with the library and use clauses for IEEE and KESTRA. */
    ORN_HDL_VHDL_USE_DEFAULT_LIBRARY = 2,
    /** List: libraries that get a library clause. */
    ORN_HDL_VHDL_LIBRARIES = 3,
    /** List: names that get a use clause. */
    ORN_HDL_VHDL_USE_CLAUSES = 4,
    /** Number: VHDL attributes have their own types instead of string. */
    ORN_HDL_VHDL_USE_ATTRIBUTE_TYPE = 5,
    /** Number: open input pins stay open in VHDL. */
    ORN_HDL_VHDL_OPEN_PIN = 6,
    /** Number: VHDL without the component declarations. */
    ORN_HDL_VHDL_SUPPRESS_COMPONENT = 7,
    /** Number: the tool for synthesis attributes, 0 to 5: QSN, Exemplar, Synplicity, Synopsys,
     * Verilog 2001, Precision. */
    ORN_HDL_VERILOG_SYNTHESIS = 8,
    /** Number: the letter case of signals, one of `ORN_HDL_CASE_KEPT` to `ORN_HDL_CASE_LOWER`. */
    ORN_HDL_VERILOG_SIGNAL_CASE = 9,
    /** Number: the letter case of instances. */
    ORN_HDL_VERILOG_INSTANCE_CASE = 10,
    /** Number: the letter case of components. */
    ORN_HDL_VERILOG_COMPONENT_CASE = 11,
    /** List: files to include. */
    ORN_HDL_VERILOG_INCLUDES = 12,
    /** Number: files begin with the header. */
    ORN_HDL_WRITE_HEADER = 13,
    /** Text: the program that the header names. */
    ORN_HDL_APPLICATION = 14,
    /** Text: the command line that the header shows. */
    ORN_HDL_COMMAND = 15,
    /** Text: the device that the header names. */
    ORN_HDL_DEVICE = 16,
    /** Text: the purpose that the header shows. */
    ORN_HDL_PURPOSE = 17,
    /** Text: the reference that the header shows. */
    ORN_HDL_REFERENCE = 18,
    /** Number: each port and each connection is written on a line of its own. */
    ORN_HDL_ONE_PORT_PER_LINE = 19,
    /** Number: set by a Verilog write that passes INIT on to instances; never read. */
    ORN_HDL_HIERARCHICAL_INIT = 20,
    /** Number: the netlists that are written are legal ones. */
    ORN_HDL_LEGAL = 21,
    /** Number: legal netlists escape names where that is enough, instead of changing them. */
    ORN_HDL_ESCAPE_NAMES = 22,
    /** Number: each netlist is read back and compared before it replaces its file. */
    ORN_HDL_VERIFY = 23,
    /** Number: how many threads may write a netlist or read a command file together. 1 is the
     * caller's alone, 0 as many as the system gives, at most 8. */
    ORN_HDL_THREADS = 24,
    /** Number: the digit "-" of a constant is a don't care, '-' in VHDL and x in Verilog. */
    ORN_HDL_DONT_CARES = 25
};

enum {
    /** Names keep their letter case. */
    ORN_HDL_CASE_KEPT = 0,
    /** Names are written in upper case. */
    ORN_HDL_CASE_UPPER = 1,
    /** Names are written in lower case. */
    ORN_HDL_CASE_LOWER = 2
};

/** The value of an option that is a number. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_number(orn_hdl_model_t model,
                                                        orn_hdl_option_t option, int* value);
/** Sets an option that is a number. An option that is on or off takes 0 and 1.
 * \return `ORN_HDL_INVALID_ARGUMENT` for any other value, and for an option that is no number. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_number(orn_hdl_model_t model,
                                                        orn_hdl_option_t option, int value);
/** The value of an option that is a text, or an element of one that is a list.
 * \param index the index of the element from 0; 0 for a text.
 * \return `ORN_HDL_END` behind the last element. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_text(orn_hdl_model_t model,
                                                      orn_hdl_option_t option, size_t index,
                                                      orn_hdl_text_t* value);
/** Sets an option that is a text; appends to one that is a list. Null empties either. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_set_text(orn_hdl_model_t model,
                                                      orn_hdl_option_t option, const char* value);

/* ---------------------------------------------------------------------------------------------- */
/* Writing                                                                                        */

/** Writes a netlist to a file, as the command WRITE does with the options of the model, the header
 * included. An existing file is replaced when everything has been written.
 * \param append 1 to append to the file instead.
 * \return `ORN_HDL_FILE` when the file cannot be written, `ORN_HDL_DIFFERS` when the options ask
 * for a proof that fails. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_write(orn_hdl_model_t model,
                                                   orn_hdl_language_t language,
                                                   const char* fileName, int append);
/** Writes a netlist to memory, where lines are neither indented nor broken, and nothing is proven.
 * \param text receives the netlist, which the caller frees with `orn_hdl_free`.
 * \param length receives its length without the NUL; may be null. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_write_text(orn_hdl_model_t model,
                                                        orn_hdl_language_t language, char** text,
                                                        size_t* length);
/** Writes the commands from which the design comes to a file, which is replaced when everything has
 * been written. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_write_commands(orn_hdl_model_t model,
                                                            const char* fileName);
/** Writes the commands from which the design comes to memory.
 * \param text receives the commands, which the caller frees with `orn_hdl_free`.
 * \param length receives their length without the NUL; may be null. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_write_commands_text(orn_hdl_model_t model, char** text,
                                                                 size_t* length);
/** The name under which a legal netlist has an object. The whole design is checked for it.
 * \return `ORN_HDL_FAILED` when there is no legal netlist. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_get_legal_name(orn_hdl_model_t model,
                                                            orn_hdl_object_t object,
                                                            orn_hdl_text_t* name);

/* ---------------------------------------------------------------------------------------------- */
/* Checking and proving                                                                           */

/** A set of targets: the bits 1 << 0 to 1 << 8 for the targets in the order of
 * `orn_hdl_get_target`. */
typedef uint32_t orn_hdl_targets_t;

/** Every target. */
#define ORN_HDL_ALL_TARGETS 0x1FFu
/** How many targets there are. */
#define ORN_HDL_TARGET_COUNT 9

/** The name of a target, such as "vhdl-93", by its index from 0; valid until the program ends.
 * \return `ORN_HDL_END` behind the last. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_get_target(size_t index, const char** name);

/** A rule of the check. Its texts are valid until the program ends. */
typedef struct orn_hdl_rule_t {
    /** The name, such as "constant-digits". */
    orn_hdl_text_t name;
    /** What is written, in one line. */
    orn_hdl_text_t what;
    /** Why it is wrong. */
    orn_hdl_text_t why;
    /** Commands that give the finding, one a line. */
    orn_hdl_text_t example;
    /** What helps. */
    orn_hdl_text_t help;
} orn_hdl_rule_t;

/** A rule of the check, by its index from 0. \return `ORN_HDL_END` behind the last. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_get_rule(size_t index, orn_hdl_rule_t* rule);

enum {
    /** The target accepts. */
    ORN_HDL_ACCEPTS = 0,
    /** The target warns. */
    ORN_HDL_WARNS = 1,
    /** The target reads something else than what is meant. */
    ORN_HDL_MISREADS = 2,
    /** The target rejects. */
    ORN_HDL_REJECTS = 3
};

/** Something that a check or a proof has found. */
typedef struct orn_hdl_finding_t {
    /** 1 for an error, 0 for a warning; 1 for each difference of a proof. */
    int32_t isError;
    /** The name of the rule; empty when there is none. */
    orn_hdl_text_t rule;
    /** What was found, in one line without a full stop. */
    orn_hdl_text_t message;
    /** Further lines, each with its line feed. */
    orn_hdl_text_t notes;
    /** What kind of command brought it in, such as "Connection". */
    orn_hdl_text_t cause;
    /** The first name in that command; empty for none. */
    orn_hdl_text_t first;
    /** The second name in that command; empty for none. */
    orn_hdl_text_t second;
    /** The line of the netlist, from 1; 0 for none. */
    uint64_t line;
    /** The column of the line, from 1; 0 for none. */
    uint64_t column;
    /** The text of the line; empty for none. */
    orn_hdl_text_t source;
    /** What each target makes of it, `ORN_HDL_ACCEPTS` to `ORN_HDL_REJECTS`. */
    int32_t verdicts[ORN_HDL_TARGET_COUNT];
} orn_hdl_finding_t;

/** Finds what targets reject, misread or warn of in the netlists that would be written.
 * \param targets whose verdicts count.
 * \param findings receives what was found, which the caller destroys. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_check(orn_hdl_model_t model, orn_hdl_targets_t targets,
                                                   orn_hdl_findings_t* findings);
/** Finds what no netlist can mend, so that no legal netlist can be written.
 * \param findings receives what was found, which the caller destroys. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_check_legal(orn_hdl_model_t model,
                                                         orn_hdl_findings_t* findings);
/** Reads a netlist and compares it with the design, which must have been written before.
 * \param findings receives the first differences, which the caller destroys; none when the netlist
 *        means what the design does.
 * \return `ORN_HDL_FAILED` when the file cannot be opened. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_model_prove(orn_hdl_model_t model,
                                                   orn_hdl_language_t language,
                                                   const char* fileName,
                                                   orn_hdl_findings_t* findings);
/** How many findings there are. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_findings_get_count(orn_hdl_findings_t findings,
                                                          size_t* count);
/** A finding, by its index from 0. \return `ORN_HDL_END` behind the last. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_findings_get(orn_hdl_findings_t findings, size_t index,
                                                    orn_hdl_finding_t* finding);
/** Destroys findings. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_findings_destroy(orn_hdl_findings_t findings);

/* ---------------------------------------------------------------------------------------------- */
/* Reading netlists                                                                               */

/** Makes a reader, which the caller destroys with `orn_hdl_reader_destroy`. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_create(orn_hdl_language_t language,
                                                     orn_hdl_reader_t* reader);
/** Destroys a reader. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_destroy(orn_hdl_reader_t reader);
/** The last failed call with this reader. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_error(orn_hdl_reader_t reader,
                                                    orn_hdl_error_t* error);
/** Chooses the module, or "ENTITY" or "ENTITY(ARCHITECTURE)", to read. Null and "" choose the only
 * one that no other one instantiates. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_set_top(orn_hdl_reader_t reader, const char* name);
/** Adds a file whose modules or entities are components; `orn_hdl_reader_read` opens it. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_add_library(orn_hdl_reader_t reader,
                                                          const char* fileName);
/** Adds the components of a model, which are copied. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_add_library_model(orn_hdl_reader_t reader,
                                                                orn_hdl_model_t model);
/** Adds a folder in which included files are looked for.
 * \return `ORN_HDL_WRONG_KIND` for a reader of VHDL. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_add_include_folder(orn_hdl_reader_t reader,
                                                                 const char* folder);
/** Defines a macro without arguments. \return `ORN_HDL_WRONG_KIND` for a reader of VHDL. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_define(orn_hdl_reader_t reader, const char* name,
                                                     const char* text);

/** A switch of a reader. */
typedef int32_t orn_hdl_switch_t;

enum {
    /** Attributes become attributes of the objects; on at first. */
    ORN_HDL_KEEP_ATTRIBUTES = 0,
    /** Comments become comments of the objects; off at first. */
    ORN_HDL_KEEP_COMMENTS = 1,
    /** Names that are not simple stay, instead of being replaced; off at first. */
    ORN_HDL_LITERAL_NAMES = 2,
    /** Verilog: an included file is not opened, but becomes one of the options; off at first. */
    ORN_HDL_KEEP_INCLUDES = 3,
    /** Verilog: modules that no file declares get the ports that instances connect; off at first.
     */
    ORN_HDL_INFER_UNDECLARED = 4,
    /** Bits x become don't cares, digits "-" of constants, and the model gets the option
     * `ORN_HDL_DONT_CARES` if there are any, instead of being errors; off at first. */
    ORN_HDL_KEEP_DONT_CARES = 5
};

/** Turns a switch on with 1 and off with 0.
 * \return `ORN_HDL_WRONG_KIND` for a reader of VHDL and a switch of Verilog's. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_set(orn_hdl_reader_t reader, orn_hdl_switch_t which,
                                                  int on);
/** Decides whether a simple name stays. \return 0 when it has to be replaced. */
typedef int (*orn_hdl_keeps_t)(void* user, const char* name);
/** Sets which simple names stay. \param keeps null for all. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_set_kept_names(orn_hdl_reader_t reader,
                                                             orn_hdl_keeps_t keeps, void* user);
/** Reads a netlist into a model. What the model held before is destroyed; after a failure it is
 * unchanged. The error has the place in its text. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_read(orn_hdl_reader_t reader, const char* fileName,
                                                   orn_hdl_model_t model);

/** A name of a file that the model does not have. */
typedef struct orn_hdl_renaming_t {
    /** The name in the file. */
    orn_hdl_text_t name;
    /** The name in the model. */
    orn_hdl_text_t newName;
    /** What has the name: "Module", "Component", "Pin", "Signal" or "Instance". */
    orn_hdl_text_t kind;
    /** Of a pin, the name of its component in the model. */
    orn_hdl_text_t component;
} orn_hdl_renaming_t;

/** A name that the last successful read has replaced, by its index from 0.
 * \return `ORN_HDL_END` behind the last. */
ORN_HDL_C_API orn_hdl_status_t orn_hdl_reader_get_renaming(orn_hdl_reader_t reader, size_t index,
                                                           orn_hdl_renaming_t* renaming);

#ifdef __cplusplus
}
#endif

#endif
