#include "diagnostics/MachineFormats.h"

#include "Port/Version.h"
#include "diagnostics/JsonWriter.h"
#include "diagnostics/Utf8.h"

#include <algorithm>
#include <cstdint>

namespace Tool {

using std::string_view;

namespace {

/// Blanks and the like are written as %XX, as in any address.
std::string ToUri(string_view file) {
    constexpr string_view Plain = "-._~/";
    constexpr string_view Digits = "0123456789ABCDEF";
    std::string uri;
    for (const char c : file) {
        const auto byte = static_cast<unsigned char>(c);
        const bool isPlain = (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') ||
                             (c >= 'a' && c <= 'z') || Plain.find(c) != string_view::npos;
        if (isPlain) {
            uri.push_back(c);
        } else {
            uri.append({'%', Digits[byte >> 4U], Digits[byte & 15U]});
        }
    }
    return uri;
}

bool HasColumns(const Place& place) {
    return place.isExact && place.line != 0 && place.columns.count != 0;
}

/// The column of a byte of the source line; the first one is 1. Columns count characters.
std::uint64_t GetColumn(const Place& place, std::size_t byte) {
    const string_view source = place.source;
    const std::size_t end = std::min(byte, source.size());
    return CountCharacters(source.substr(0, end)) + (byte - end) + 1;
}

std::uint64_t GetFirstColumn(const Place& place) {
    return GetColumn(place, place.columns.first);
}

/// The column behind the last one.
std::uint64_t GetEndColumn(const Place& place) {
    return GetColumn(place, place.columns.first + place.columns.count);
}

void WriteText(JsonWriter& json, string_view key, string_view text) {
    json.Key(key).BeginObject().Key("text").Text(text).EndObject();
}

void WriteRuleList(JsonWriter& json, const std::vector<RuleTexts>& rules) {
    json.Key("rules").BeginArray();
    for (const RuleTexts& rule : rules) {
        json.BeginObject().Key("id").Text(rule.name);
        WriteText(json, "shortDescription", rule.what);
        if (!rule.why.empty()) {
            WriteText(json, "fullDescription", rule.why);
        }
        if (!rule.help.empty()) {
            WriteText(json, "help", rule.help);
        }
        json.EndObject();
    }
    json.EndArray();
}

void WriteRegion(JsonWriter& json, const Place& place) {
    json.Key("region").BeginObject();
    json.Key("startLine").Number(std::max<std::uint64_t>(place.line, 1));
    if (HasColumns(place)) {
        json.Key("startColumn").Number(GetFirstColumn(place));
        json.Key("endColumn").Number(GetEndColumn(place));
    }
    json.EndObject();
}

/// The caller may add a message before it ends the object.
void BeginLocation(JsonWriter& json, const Place& place) {
    json.BeginObject().Key("physicalLocation").BeginObject();
    json.Key("artifactLocation").BeginObject().Key("uri").Text(ToUri(place.file)).EndObject();
    WriteRegion(json, place);
    json.EndObject();
}

void WriteRelated(JsonWriter& json, const std::vector<Note>& notes) {
    const auto isElsewhere = [](const Note& note) { return note.place.line != 0; };
    if (std::none_of(notes.begin(), notes.end(), isElsewhere)) {
        return;
    }
    json.Key("relatedLocations").BeginArray();
    for (const Note& note : notes) {
        if (isElsewhere(note)) {
            BeginLocation(json, note.place);
            WriteText(json, "message", note.text);
            json.EndObject();
        }
    }
    json.EndArray();
}

void WriteResult(JsonWriter& json, const Diagnostic& diagnostic) {
    std::string text = diagnostic.message;
    for (const Note& note : diagnostic.notes) {
        text.append("\n").append(note.text);
    }
    json.BeginObject();
    if (!diagnostic.rule.empty()) {
        json.Key("ruleId").Text(diagnostic.rule);
    }
    json.Key("level").Text(GetSeverityName(diagnostic.severity));
    WriteText(json, "message", text);
    json.Key("locations").BeginArray();
    BeginLocation(json, diagnostic.place);
    json.EndObject().EndArray();
    WriteRelated(json, diagnostic.notes);
    json.EndObject();
}

/// File, line and columns, as far as they are known.
void WritePlace(JsonWriter& json, const Place& place) {
    json.Key("file").Text(place.file);
    if (place.line != 0) {
        json.Key("line").Number(place.line);
    }
    if (HasColumns(place)) {
        json.Key("column").Number(GetFirstColumn(place));
        json.Key("endColumn").Number(GetEndColumn(place));
    }
}

void WriteDiagnostic(JsonWriter& json, const Diagnostic& diagnostic) {
    json.BeginObject().Key("severity").Text(GetSeverityName(diagnostic.severity));
    if (!diagnostic.rule.empty()) {
        json.Key("rule").Text(diagnostic.rule);
    }
    WritePlace(json, diagnostic.place);
    json.Key("message").Text(diagnostic.message);
    json.Key("notes").BeginArray();
    for (const Note& note : diagnostic.notes) {
        json.BeginObject();
        if (note.place.line != 0) {
            WritePlace(json, note.place);
        }
        json.Key("message").Text(note.text).EndObject();
    }
    json.EndArray().EndObject();
}

std::uint64_t Count(const std::vector<Diagnostic>& diagnostics, Severity severity) {
    return static_cast<std::uint64_t>(
        std::count_if(diagnostics.begin(), diagnostics.end(), [&](const Diagnostic& diagnostic) {
            return diagnostic.severity == severity;
        }));
}

} // namespace

std::string FormatSarif(const std::vector<Diagnostic>& diagnostics,
                        const std::vector<RuleTexts>& rules) {
    JsonWriter json;
    json.BeginObject();
    json.Key("$schema").Text("https://json.schemastore.org/sarif-2.1.0.json");
    json.Key("version").Text("2.1.0").Key("runs").BeginArray().BeginObject();
    json.Key("columnKind").Text("unicodeCodePoints");
    json.Key("tool").BeginObject().Key("driver").BeginObject();
    json.Key("name").Text("orn-hdl");
    json.Key("version").Text(Port::Version::getValue("version").GetView());
    WriteRuleList(json, rules);
    json.EndObject().EndObject().Key("results").BeginArray();
    for (const Diagnostic& diagnostic : diagnostics) {
        WriteResult(json, diagnostic);
    }
    json.EndArray().EndObject().EndArray().EndObject();
    return json.Take();
}

std::string FormatJson(const std::vector<Diagnostic>& diagnostics) {
    JsonWriter json;
    json.BeginObject().Key("diagnostics").BeginArray();
    for (const Diagnostic& diagnostic : diagnostics) {
        WriteDiagnostic(json, diagnostic);
    }
    json.EndArray();
    json.Key("errors").Number(Count(diagnostics, Severity::Error));
    json.Key("warnings").Number(Count(diagnostics, Severity::Warning));
    json.EndObject();
    return json.Take();
}

} // namespace Tool
