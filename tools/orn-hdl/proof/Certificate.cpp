#include "proof/Certificate.h"

#include "Gzip.h"
#include "Output.h"
#include "diagnostics/JsonWriter.h"
#include "stats/Count.h"

#include "Orn_Hdl/Model/Netlist.h"
#include "Port/File.h"
#include "Port/Version.h"

#include <array>
#include <cstdint>
#include <utility>

#include <nettle/sha2.h>

namespace Tool {

namespace {

/// The SHA-256 of a file in hexadecimal digits.
Status FindDigest(const std::string& name, const std::string& systemName, std::string& digest) {
    Port::File file;
    if (!file.open(systemName.c_str(), Port::File::Read, true)) {
        return ComplainUnreadable(name, file.GetError());
    }
    sha256_ctx context;
    sha256_init(&context);
    std::array<char, 65536> piece;
    while (const std::size_t count = file.read(piece.data(), piece.size())) {
        sha256_update(&context, count, reinterpret_cast<const std::uint8_t*>(piece.data()));
    }
    if (file.GetError() != 0) {
        return ComplainUnreadable(name, file.GetError());
    }
    std::array<std::uint8_t, SHA256_DIGEST_SIZE> bytes;
    sha256_digest(&context, bytes.size(), bytes.data());
    constexpr const char* Digits = "0123456789abcdef";
    for (const std::uint8_t byte : bytes) {
        digest += Digits[byte >> 4U];
        digest += Digits[byte & 0xFU];
    }
    return Status::Success;
}

} // namespace

Status Certificate::AddCommands(const std::string& name, const std::string& systemName) {
    if (!IsWanted()) {
        return Status::Success;
    }
    File file;
    file.name = name;
    const Status status = FindDigest(name, IsGzip(name) ? name : systemName, file.digest);
    commands_.push_back(std::move(file));
    return status;
}

Status Certificate::AddInput(const std::string& name) {
    File file;
    file.name = name;
    const Status status = FindDigest(name, name, file.digest);
    inputs_.push_back(std::move(file));
    return status;
}

Status Certificate::AddNetlist(const std::string& name, Orn_Hdl::Language language,
                               const Orn_Hdl::Netlist& design) {
    if (!IsWanted()) {
        return Status::Success;
    }
    const Stats::DesignCounts counts = Stats::CountDesign(design);
    std::uint64_t ports = 0;
    for (const auto& [direction, count] : counts.ports) {
        ports += count.signals;
    }
    std::uint64_t attributes = 0;
    for (const Stats::AttributeCount& count : counts.attributes) {
        attributes += count.attributes;
    }
    File file;
    file.name = name;
    file.language = Orn_Hdl::GetLanguageName(language);
    file.module = design.GetNameView();
    file.counts = {{"ports", ports},
                   {"signals", counts.signals.signals},
                   {"nets", counts.nets},
                   {"components", counts.components.size()},
                   {"instances", counts.instances},
                   {"pins", counts.pins},
                   {"openPins", counts.openPins},
                   {"constants", counts.constants},
                   {"aliases", counts.aliases},
                   {"attributes", attributes}};
    const Status status = FindDigest(name, name, file.digest);
    netlists_.push_back(std::move(file));
    return status;
}

void Certificate::WriteFiles(JsonWriter& json, const char* key, const std::vector<File>& files) {
    if (files.empty()) {
        return;
    }
    json.Key(key).BeginArray();
    for (const File& file : files) {
        json.BeginObject().Key("file").Text(file.name).Key("sha256").Text(file.digest).EndObject();
    }
    json.EndArray();
}

Status Certificate::Write() const {
    OutputFile output(fileName_);
    Port::Stream* const out = output.GetStream();
    if (out == nullptr) {
        return output.Flush();
    }
    JsonWriter json;
    json.BeginObject().Key("tool").Text("orn-hdl").Key("version");
    json.Text(Port::Version::getValue("version").GetView());
    WriteFiles(json, "commands", commands_);
    WriteFiles(json, "inputs", inputs_);
    json.Key("netlists").BeginArray();
    for (const File& file : netlists_) {
        json.BeginObject().Key("file").Text(file.name).Key("language").Text(file.language);
        json.Key("module").Text(file.module).Key("sha256").Text(file.digest);
        for (const Count& count : file.counts) {
            json.Key(count.name).Number(count.number);
        }
        json.EndObject();
    }
    *out << json.EndArray().EndObject().Take().c_str();
    return output.Commit();
}

} // namespace Tool
