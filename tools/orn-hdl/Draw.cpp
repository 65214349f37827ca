#include "Draw.h"

#include "NoWrites.h"
#include "Output.h"
#include "Progress.h"
#include "Run.h"
#include "draw/DesignGraph.h"
#include "draw/DotWriter.h"

#include "Orn_Hdl/Orn_Hdl.h"
#include "Port/File.h"

#include <array>
#include <cerrno>
#include <cstdio>
#include <memory>
#include <spawn.h>
#include <string_view>
#include <sys/wait.h>
#include <unistd.h>

// Not every system declares it. NOLINTNEXTLINE(readability-redundant-declaration)
extern char** environ;

namespace Tool {

namespace {

/// Graphviz needs minutes for more.
constexpr std::size_t MostBoxes = 5000;

using CFile = std::unique_ptr<std::FILE, int (*)(std::FILE*)>;

/// An unnamed temporary file that contains a text, positioned at its start.
CFile MakeTemporaryFile(std::string_view text) {
    CFile file(std::tmpfile(), &std::fclose);
    if (file != nullptr &&
        (std::fwrite(text.data(), 1, text.size(), file.get()) != text.size() ||
         std::fflush(file.get()) != 0 || lseek(fileno(file.get()), 0, SEEK_SET) != 0)) {
        file.reset();
    }
    return file;
}

/// Starts dot. \return 0, or the system's error number.
int StartDot(int input, int output, pid_t& process) {
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, input, STDIN_FILENO);
    posix_spawn_file_actions_adddup2(&actions, output, STDOUT_FILENO);
    std::string name("dot");
    std::string format("-Tsvg");
    std::array<char*, 3> arguments = {name.data(), format.data(), nullptr};
    const int error =
        posix_spawnp(&process, name.c_str(), &actions, nullptr, arguments.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    return error;
}

/// Draws a graph with Graphviz. \param picture receives the text of the picture.
Status RunDot(std::string_view graph, std::string& picture) {
    const CFile input = MakeTemporaryFile(graph);
    const CFile output = MakeTemporaryFile("");
    if (input == nullptr || output == nullptr) {
        return ComplainUnwritable("a temporary file", errno);
    }
    pid_t process = 0;
    const int error = StartDot(fileno(input.get()), fileno(output.get()), process);
    if (error != 0) {
        Complain("cannot run dot: " + std::string(Port::ErrorText(error).GetView()) +
                 "; install Graphviz");
        return Status::File;
    }
    int result = 0;
    while (waitpid(process, &result, 0) < 0 && errno == EINTR) {
    }
    if (result != 0) {
        Complain("dot could not draw the design");
        return Status::File;
    }
    std::rewind(output.get());
    std::array<char, 65536> piece;
    for (std::size_t count = piece.size(); count == piece.size();) {
        count = std::fread(piece.data(), 1, piece.size(), output.get());
        picture.append(piece.data(), count);
    }
    return Status::Success;
}

Status WritePicture(const std::string& name, std::string_view picture) {
    OutputFile file(name);
    if (Port::Stream* out = file.GetStream()) {
        *out << picture;
    }
    return file.Commit();
}

Status DrawNetlist(const Orn_Hdl::Netlist& netlist, const DrawOptions& options) {
    DesignGraph graph(netlist);
    if (!options.around.empty() && !graph.KeepAround(options.around, options.depth)) {
        Complain("there is no instance and no signal " + options.around);
        return Status::Usage;
    }
    if (graph.CountDrawnBoxes() > MostBoxes) {
        Complain(std::to_string(graph.CountDrawnBoxes()) +
                 " instances are too many for a picture, " + std::to_string(MostBoxes) +
                 " the most; choose a smaller part with --around and --depth");
        return Status::Usage;
    }
    std::string picture;
    const Status drawn = RunDot(DotWriter(graph).Write(), picture);
    return drawn == Status::Success ? WritePicture(options.output, picture) : drawn;
}

} // namespace

Status Draw(const DrawOptions& options) {
    Orn_Hdl::Engine engine;
    engine.CreateAndAddModel("", options.file.c_str());
    Orn_Hdl::Model& model = *engine.GetModel("");
    DropWrites(*model.GetCommandFactory());
    Progress progress(true, options.file);
    CommandFile file(options.file, options.report, progress);
    const Replayed replayed = Replay(model, file, false);
    file.reporter.Finish();
    return replayed.complete ? DrawNetlist(*model.GetNetlist(), options) : replayed.status;
}

} // namespace Tool
