// Every function of the C interface in random order, with handles that are good, null, dead, of
// other kinds or mere numbers: each call returns one of the statuses, and nothing crashes or leaks.
#include "C/Session.h"
#include "Support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <functional>
#include <iterator>
#include <random>
#include <string>
#include <vector>

namespace {

class RandomCalls {
public:
    explicit RandomCalls(unsigned seed) : random_(seed) {
        Support::WriteWholeFile(commands_, CTests::SmallDesign);
        Support::WriteWholeFile(netlist_, "module top(a, y);\n  input a;\n  output y;\n"
                                          "  assign y = a;\nendmodule\n");
        for (int i = 0; i < 2; ++i) {
            CreateEngine();
        }
    }
    RandomCalls(const RandomCalls&) = delete;
    RandomCalls& operator=(const RandomCalls&) = delete;
    ~RandomCalls() {
        for (const std::uint64_t id : ids_) {
            orn_hdl_engine_destroy({id});
            orn_hdl_reader_destroy({id});
            orn_hdl_findings_destroy({id});
        }
    }

    /// Makes one call. Callbacks make further ones.
    void Call() {
        constexpr std::size_t CallsPerEngine = 100;
        if (++calls_ % CallsPerEngine == 0) {
            CreateEngine();
        }
        const auto& functions = GetFunctions();
        const orn_hdl_status_t status = functions[Draw(functions.size())](*this);
        EXPECT_GE(status, ORN_HDL_OK);
        EXPECT_LE(status, ORN_HDL_UNEXPECTED);
        EXPECT_NE(status, ORN_HDL_UNEXPECTED);
        EXPECT_NE(status, ORN_HDL_NO_MEMORY);
        ++counts_[status >= 0 && status < 15 ? static_cast<std::size_t>(status) : 0];
    }

    std::size_t GetCount(orn_hdl_status_t status) const {
        return counts_[static_cast<std::size_t>(status)];
    }

    using Function = std::function<orn_hdl_status_t(RandomCalls&)>;
    static const std::vector<Function>& GetFunctions();

private:
    std::size_t Draw(std::size_t count) { return random_() % count; }

    /// The number of a handle: mostly a good one, but also dead ones, null and any number.
    std::uint64_t Id() {
        const std::size_t draw = Draw(20);
        if (draw == 0) {
            return 0;
        }
        if (draw == 1) {
            return (std::uint64_t(random_()) << 32U) | random_();
        }
        return ids_[draw < 4 ? Draw(ids_.size()) : ids_.size() - 1 - Draw(RecentIds)];
    }
    orn_hdl_engine_t E() { return {Draw(8) == 0 ? Id() : engine_.id}; }
    orn_hdl_model_t M() { return {Draw(8) == 0 ? Id() : model_.id}; }
    orn_hdl_reader_t R() { return {Draw(8) == 0 ? Id() : reader_.id}; }
    orn_hdl_findings_t F() { return {Draw(4) == 0 ? Id() : findings_.id}; }
    orn_hdl_object_t& Slot() { return objects_[Draw(std::size(objects_))]; }
    orn_hdl_object_t O() {
        orn_hdl_object_t object = Slot();
        switch (Draw(30)) {
        case 0:
            return {};
        case 1:
            object.stamp ^= std::uint64_t(1) << Draw(64);
            return object;
        case 2:
            object.model = Id();
            return object;
        default:
            return object;
        }
    }
    orn_hdl_cursor_t* C() {
        if (Draw(50) == 0) {
            return nullptr;
        }
        if (Draw(20) == 0) {
            cursor_.index = static_cast<std::int32_t>(random_());
            cursor_.list = static_cast<std::int32_t>(Draw(10));
        }
        return &cursor_;
    }
    std::int32_t Number() {
        return Draw(10) == 0 ? static_cast<std::int32_t>(random_())
                             : static_cast<std::int32_t>(Draw(26));
    }
    const char* T() {
        static constexpr const char* Texts[] = {
            nullptr,  "",      "top",    "other",  "INV",    "ROM",    "U1",      "U2",
            "U3",     "I",     "O",      "A(3:0)", "D(7:0)", "D(2)",   "D",       "D(7:6),Y",
            "Y",      "N",     "W(0:3)", "W",      "input",  "output", "inout",   "LOC",
            "INIT",   "NONE",  "SYN",    "ASSIGN", "4:H:A",  "1",      "Integer", "User",
            "String", "\xff(", "a b\n",  "D(-1:)"};
        return Texts[Draw(std::size(Texts))];
    }
    const char* Line() {
        static constexpr const char* Lines[] = {nullptr,
                                                "",
                                                "ADD COMPONENT INV",
                                                "ADD PIN INV I input",
                                                "ADD PIN INV O output",
                                                "ADD INSTANCE INV U1",
                                                "ADD INSTANCE INV U3",
                                                "ADD PORT Y output",
                                                "CONNECT SIGNAL W(3:0) U2.A(3:0)",
                                                "CONNECT SIGNAL W(9:0) V(9:0)",
                                                "CONNECT SIGNAL D(2) U1.I",
                                                "CONNECT SIGNAL Y,N U1.I",
                                                "SET NETLIST NAME other",
                                                "ADD SIGNAL ATTRIBUTE Y LOC P4",
                                                "BAD"};
        return Lines[Draw(std::size(Lines))];
    }
    const char* File() {
        const std::string* const files[] = {&commands_, &netlist_, &output_, &folderName_};
        return Draw(10) == 0 ? T() : files[Draw(std::size(files))]->c_str();
    }
    template <class Result> Result* Out(Result& result) {
        return Draw(40) == 0 ? nullptr : &result;
    }

    /// Keeps a number that a call has made.
    template <class Handle>
    orn_hdl_status_t Keep(orn_hdl_status_t status, Handle& kept, const Handle& made) {
        if (status == ORN_HDL_OK) {
            ids_.push_back(made.id);
            kept = made;
        }
        return status;
    }
    orn_hdl_status_t CreateEngine() {
        orn_hdl_engine_t engine;
        const orn_hdl_status_t status = orn_hdl_engine_create(&engine);
        Keep(status, engine_, engine);
        AddModel(engine);
        return status;
    }
    orn_hdl_status_t AddModel(orn_hdl_engine_t engine) {
        orn_hdl_model_t model;
        const char* const name = T();
        const orn_hdl_status_t status = orn_hdl_engine_add_model(engine, name, T(), &model);
        Keep(status, model_, model);
        orn_hdl_engine_use_model(engine, name);
        orn_hdl_model_execute_lines(status == ORN_HDL_OK ? model : model_, CTests::SmallDesign,
                                    std::char_traits<char>::length(CTests::SmallDesign));
        orn_hdl_model_get_netlist(model_, &Slot());
        return status;
    }

    /// A callback makes a few calls of its own.
    int Nested() {
        if (depth_ < 2) {
            ++depth_;
            for (int i = 0; i < 3; ++i) {
                Call();
            }
            --depth_;
        }
        return Draw(4) == 0 ? 1 : 0;
    }
    static int OnProgress(void* user, std::uint64_t, std::uint64_t) {
        return static_cast<RandomCalls*>(user)->Nested();
    }
    static int OnFailure(void* user, const orn_hdl_error_t*) {
        return static_cast<RandomCalls*>(user)->Nested();
    }
    static int OnWire(void* user, const orn_hdl_text_t*, const orn_hdl_wire_t*) {
        return static_cast<RandomCalls*>(user)->Nested();
    }
    static int OnName(void* user, const char*) {
        return 1 - static_cast<RandomCalls*>(user)->Nested();
    }
    static const char* OnFile(void* user, const char*) {
        return static_cast<RandomCalls*>(user)->Nested() == 0 ? nullptr : "no";
    }

    static constexpr std::size_t RecentIds = 4;

    std::mt19937 random_;
    const Support::TemporaryFolder folder_;
    const std::string folderName_ = folder_.GetPath();
    const std::string commands_ = folder_ / "a.cmd";
    const std::string netlist_ = folder_ / "a.v";
    const std::string output_ = folder_ / "out";
    std::vector<std::uint64_t> ids_ = std::vector<std::uint64_t>(RecentIds, 0);
    orn_hdl_engine_t engine_ = {};
    orn_hdl_model_t model_ = {};
    orn_hdl_reader_t reader_ = {};
    orn_hdl_findings_t findings_ = {};
    orn_hdl_object_t objects_[12] = {};
    orn_hdl_cursor_t cursor_ = {};
    int depth_ = 0;
    std::size_t calls_ = 0;
    std::size_t counts_[15] = {};

    // Results that nobody looks at.
    orn_hdl_text_t text_ = {};
    orn_hdl_error_t error_ = {};
    int number_ = 0;
    std::int32_t left_ = 0;
    std::int32_t right_ = 0;
    size_t size_ = 0;
};

const std::vector<RandomCalls::Function>& RandomCalls::GetFunctions() {
    using S = RandomCalls;
    static const std::vector<Function> functions = {
        // Engines
        [](S& s) { return s.Draw(8) == 0 ? s.CreateEngine() : orn_hdl_engine_create(nullptr); },
        [](S& s) {
            // Engines are destroyed now and then, so that the calls between find designs.
            return s.Draw(20) == 0 ? orn_hdl_engine_destroy(s.E())
                                   : orn_hdl_engine_destroy({s.ids_[s.Draw(s.ids_.size())]});
        },
        [](S& s) { return s.AddModel(s.E()); },
        [](S& s) { return orn_hdl_engine_add_model(s.E(), s.T(), s.T(), nullptr); },
        [](S& s) { return orn_hdl_engine_get_model(s.E(), s.T(), s.Out(s.model_)); },
        [](S& s) { return orn_hdl_engine_use_model(s.E(), s.T()); },
        [](S& s) { return orn_hdl_engine_remove_model(s.E(), s.T()); },
        [](S& s) { return orn_hdl_model_destroy({s.Id()}); },
        [](S& s) { return orn_hdl_engine_execute(s.E(), s.Line()); },
        [](S& s) { return orn_hdl_engine_replay(s.E(), s.T(), s.File()); },
        [](S& s) { return orn_hdl_engine_error(s.E(), s.Out(s.error_)); },
        // Lines, files and state
        [](S& s) { return orn_hdl_model_execute(s.M(), s.Line()); },
        [](S& s) { return orn_hdl_model_execute(s.M(), s.Line()); },
        [](S& s) { return orn_hdl_model_execute_lines(s.M(), CTests::SmallDesign, s.Draw(200)); },
        [](S& s) { return orn_hdl_model_execute_lines(s.M(), nullptr, s.Draw(2)); },
        [](S& s) {
            return orn_hdl_model_replay(s.M(), s.File(), &OnProgress,
                                        s.Draw(2) == 0 ? &OnFailure : nullptr, &s);
        },
        [](S& s) { return orn_hdl_model_error(s.M(), s.Out(s.error_)); },
        [](S& s) { return orn_hdl_model_set_guard(s.M(), s.Draw(2) == 0 ? &OnFile : nullptr, &s); },
        [](S& s) {
            return orn_hdl_model_get_last_write(s.M(), s.Out(s.number_), nullptr, s.Out(s.text_));
        },
        [](S& s) { return orn_hdl_model_get_done_count(s.M(), s.Out(s.size_)); },
        [](S& s) { return orn_hdl_model_clear_done(s.M()); },
        [](S& s) { return orn_hdl_model_get_name(s.M(), s.Out(s.text_)); },
        [](S& s) { return orn_hdl_model_set_name(s.M(), s.T()); },
        [](S& s) { return orn_hdl_model_get_source_file(s.M(), s.Out(s.text_)); },
        [](S& s) { return orn_hdl_model_set_source_file(s.M(), s.T()); },
        [](S& s) { return orn_hdl_model_is_modified(s.M(), s.Out(s.number_)); },
        [](S& s) { return orn_hdl_model_set_modified(s.M(), s.Number()); },
        // Operations
        [](S& s) { return orn_hdl_model_add_component(s.M(), s.T()); },
        [](S& s) { return orn_hdl_model_add_pin(s.M(), s.T(), s.T(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_model_add_instance(s.M(), s.T(), s.T()); },
        [](S& s) {
            const char* const names[] = {s.T(), s.T(), s.T()};
            return orn_hdl_model_add_instances(s.M(), s.T(), s.Draw(10) == 0 ? nullptr : names, 3,
                                               s.Out(s.size_));
        },
        [](S& s) { return orn_hdl_model_add_signal(s.M(), s.T()); },
        [](S& s) { return orn_hdl_model_add_port(s.M(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_model_bit(s.M(), s.T(), s.Number(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_model_rename_component(s.M(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_model_rename_instance(s.M(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_model_rename_signal(s.M(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_model_connect(s.M(), s.T(), s.T(), s.T()); },
        [](S& s) {
            const orn_hdl_connection_t connections[] = {{s.T(), s.T(), s.T()}, {"Y", "U1", "I"}};
            return orn_hdl_model_connect_many(s.M(), s.Draw(10) == 0 ? nullptr : connections, 2,
                                              s.Out(s.size_));
        },
        [](S& s) { return orn_hdl_model_connect_signals(s.M(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_model_assign_signal(s.M(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_model_assign_pin(s.M(), s.T(), s.T(), s.T()); },
        [](S& s) {
            return orn_hdl_model_add_attribute(s.M(), s.Number() % 8, s.T(), s.T(), s.T(), s.T(),
                                               s.T());
        },
        [](S& s) {
            return orn_hdl_model_set_attribute(s.M(), s.Number() % 8, s.T(), s.T(), s.T(), s.T());
        },
        [](S& s) {
            return orn_hdl_model_set_generic(s.M(), s.Number() % 8, s.T(), s.T(), s.T(), s.T());
        },
        [](S& s) {
            return orn_hdl_model_set_synthesis(s.M(), s.Number() % 8, s.T(), s.T(), s.T(), s.T());
        },
        [](S& s) {
            return orn_hdl_model_set_user_type(s.M(), s.Number() % 8, s.T(), s.T(), s.T(), s.T());
        },
        [](S& s) { return orn_hdl_model_add_comment(s.M(), s.Number() % 8, s.T(), s.T(), s.T()); },
        // Objects
        [](S& s) { return orn_hdl_model_get_netlist(s.M(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_model_get_component(s.M(), s.T(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_model_get_instance(s.M(), s.T(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_model_get_signal(s.M(), s.T(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_object_get_pin(s.O(), s.T(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_object_get_attribute(s.O(), s.T(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_object_walk(s.O(), s.Number() % 9, s.C()); },
        [](S& s) { return orn_hdl_cursor_next(s.C(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_cursor_next(s.C(), s.Out(s.Slot())); },
        [](S& s) {
            return orn_hdl_cursor_next_many(s.C(), s.objects_, s.Draw(std::size(s.objects_)),
                                            s.Out(s.size_));
        },
        [](S& s) { return orn_hdl_object_get_kind(s.O(), s.Out(s.left_)); },
        [](S& s) { return orn_hdl_object_get_name(s.O(), s.Out(s.text_)); },
        [](S& s) { return orn_hdl_object_get_comment(s.O(), s.Out(s.text_)); },
        [](S& s) { return orn_hdl_object_get_direction(s.O(), s.Out(s.left_)); },
        [](S& s) { return orn_hdl_object_get_width(s.O(), s.Out(s.left_)); },
        [](S& s) {
            return orn_hdl_object_get_range(s.O(), s.Out(s.text_), s.Out(s.left_), s.Out(s.right_));
        },
        [](S& s) {
            orn_hdl_constant_t constant;
            return orn_hdl_object_get_constant(s.O(), s.Out(constant));
        },
        [](S& s) { return orn_hdl_instance_get_component(s.O(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_pin_get_signal(s.O(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_part_get_bus(s.O(), s.Out(s.Slot())); },
        [](S& s) { return orn_hdl_signal_get_dummy(s.O(), s.Out(s.Slot())); },
        [](S& s) {
            orn_hdl_attribute_t attribute;
            return orn_hdl_attribute_get(s.O(), s.Out(attribute));
        },
        [](S& s) {
            orn_hdl_wire_t wires[3];
            return orn_hdl_instance_get_wires(s.O(), s.Out(wires[0]), s.Draw(2), s.Out(s.size_));
        },
        [](S& s) {
            return orn_hdl_model_visit_wires(s.M(), s.Draw(10) == 0 ? nullptr : &OnWire, &s);
        },
        [](S& s) { return orn_hdl_object_remove(s.O()); },
        // Options
        [](S& s) { return orn_hdl_model_get_number(s.M(), s.Number(), s.Out(s.number_)); },
        [](S& s) { return orn_hdl_model_set_number(s.M(), s.Number(), s.Number() % 4); },
        [](S& s) { return orn_hdl_model_get_text(s.M(), s.Number(), s.Draw(3), s.Out(s.text_)); },
        [](S& s) { return orn_hdl_model_set_text(s.M(), s.Number(), s.T()); },
        // Writing
        [](S& s) {
            const std::string file = s.Draw(4) == 0 ? "/nowhere/out" : s.output_;
            return orn_hdl_model_write(s.M(), s.Number() % 3, file.c_str(), s.Number() % 2);
        },
        [](S& s) {
            char* text = nullptr;
            const orn_hdl_status_t status =
                orn_hdl_model_write_text(s.M(), s.Number() % 3, s.Out(text), s.Out(s.size_));
            orn_hdl_free(text);
            return status;
        },
        [](S& s) { return orn_hdl_model_write_commands(s.M(), s.output_.c_str()); },
        [](S& s) {
            char* text = nullptr;
            const orn_hdl_status_t status =
                orn_hdl_model_write_commands_text(s.M(), s.Out(text), s.Out(s.size_));
            orn_hdl_free(text);
            return status;
        },
        [](S& s) { return orn_hdl_model_get_legal_name(s.M(), s.O(), s.Out(s.text_)); },
        // Checking and proving
        [](S& s) {
            orn_hdl_findings_t made = {};
            return s.Keep(orn_hdl_model_check(s.M(), static_cast<orn_hdl_targets_t>(s.random_()),
                                              s.Out(made)),
                          s.findings_, made);
        },
        [](S& s) {
            orn_hdl_findings_t made = {};
            return s.Keep(orn_hdl_model_check_legal(s.M(), s.Out(made)), s.findings_, made);
        },
        [](S& s) {
            orn_hdl_findings_t made = {};
            return s.Keep(orn_hdl_model_prove(s.M(), s.Number() % 3, s.File(), s.Out(made)),
                          s.findings_, made);
        },
        [](S& s) { return orn_hdl_findings_get_count(s.F(), s.Out(s.size_)); },
        [](S& s) {
            orn_hdl_finding_t finding;
            return orn_hdl_findings_get(s.F(), s.Draw(3), s.Out(finding));
        },
        [](S& s) { return orn_hdl_findings_destroy(s.F()); },
        // Readers
        [](S& s) {
            orn_hdl_reader_t made = {};
            return s.Keep(orn_hdl_reader_create(s.Number() % 3, s.Out(made)), s.reader_, made);
        },
        [](S& s) {
            return s.Draw(4) == 0 ? orn_hdl_reader_destroy(s.R())
                                  : orn_hdl_reader_destroy({s.Id()});
        },
        [](S& s) { return orn_hdl_reader_error(s.R(), s.Out(s.error_)); },
        [](S& s) { return orn_hdl_reader_set_top(s.R(), s.T()); },
        [](S& s) { return orn_hdl_reader_add_library(s.R(), s.File()); },
        [](S& s) { return orn_hdl_reader_add_library_model(s.R(), s.M()); },
        [](S& s) { return orn_hdl_reader_add_include_folder(s.R(), s.T()); },
        [](S& s) { return orn_hdl_reader_define(s.R(), s.T(), s.T()); },
        [](S& s) { return orn_hdl_reader_set(s.R(), s.Number() % 6, s.Number() % 2); },
        [](S& s) {
            return orn_hdl_reader_set_kept_names(s.R(), s.Draw(2) == 0 ? &OnName : nullptr, &s);
        },
        [](S& s) { return orn_hdl_reader_read(s.R(), s.File(), s.M()); },
        [](S& s) {
            orn_hdl_renaming_t renaming;
            return orn_hdl_reader_get_renaming(s.R(), s.Draw(3), s.Out(renaming));
        },
        // The library
        [](S& s) { return orn_hdl_is_keyword(s.Number() % 3, s.T(), s.Out(s.number_)); },
        [](S& s) {
            orn_hdl_command_t command;
            return orn_hdl_get_command(s.Draw(70), s.Out(command));
        },
        [](S& s) {
            const char* name = nullptr;
            return orn_hdl_get_target(s.Draw(12), s.Out(name));
        },
        [](S& s) {
            orn_hdl_rule_t rule;
            return orn_hdl_get_rule(s.Draw(100), s.Out(rule));
        },
    };
    return functions;
}

TEST(CRandomCalls, NothingCrashes) {
    constexpr int Calls = 15000;
    for (unsigned seed = 1; seed <= 6; ++seed) {
        SCOPED_TRACE(seed);
        RandomCalls calls(seed);
        for (int i = 0; i < Calls; ++i) {
            calls.Call();
        }
        // The calls are not all refused, and each kind of refusal occurs.
        EXPECT_GT(calls.GetCount(ORN_HDL_OK), std::size_t(Calls) / 5);
        for (const orn_hdl_status_t status :
             {ORN_HDL_END, ORN_HDL_NULL_HANDLE, ORN_HDL_DEAD_HANDLE, ORN_HDL_WRONG_KIND,
              ORN_HDL_INVALID_ARGUMENT, ORN_HDL_NOT_FOUND, ORN_HDL_FAILED, ORN_HDL_BUSY}) {
            EXPECT_GT(calls.GetCount(status), 0U) << orn_hdl_status_text(status);
        }
    }
}

} // namespace
