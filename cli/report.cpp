#include "report.h"

#include <cstdio>

namespace {

constexpr const char* kFailedToMatch = "Failed to match tag=";
constexpr const char* kLineBreakNote =
    "messages must follow one another directly: a line break between messages, or after "
    "the last one, is read as the start of the next tag";

// The tag of a "Failed to match tag=" finding starts with a line break.
bool tagStartsWithLineBreak(const std::string& message) {
    const std::string prefix = kFailedToMatch;
    if (message.compare(0, prefix.size(), prefix) != 0 || message.size() <= prefix.size())
        return false;
    const char c = message[prefix.size()];
    return c == '\r' || c == '\n';
}

std::string hexEscape(const char* format, unsigned value) {
    char buffer[8];
    std::snprintf(buffer, sizeof buffer, format, value);
    return buffer;
}

}  // namespace

const char* kindName(int32_t kind) {
    switch (kind) {
        case 2:
            return "field error";
        case 3:
            return "error";
        default:
            return "finding";
    }
}

std::string escapeControls(const std::string& text) {
    std::string out;
    out.reserve(text.size());
    for (const char c : text) {
        const auto u = static_cast<unsigned char>(c);
        if (c == '\r') {
            out += "\\r";
        } else if (c == '\n') {
            out += "\\n";
        } else if (c == '\t') {
            out += "\\t";
        } else if (u < 0x20 || u == 0x7F) {
            out += hexEscape("\\x%02x", u);
        } else {
            out += c;
        }
    }
    return out;
}

std::string jsonString(const std::string& text) {
    std::string out = "\"";
    for (const char c : text) {
        const auto u = static_cast<unsigned char>(c);
        switch (c) {
            case '"':
                out += "\\\"";
                break;
            case '\\':
                out += "\\\\";
                break;
            case '\n':
                out += "\\n";
                break;
            case '\r':
                out += "\\r";
                break;
            case '\t':
                out += "\\t";
                break;
            default:
                if (u < 0x20 || u == 0x7F) {
                    out += hexEscape("\\u%04x", u);
                } else {
                    out += c;
                }
        }
    }
    return out + "\"";
}

void printFile(std::ostream& out, OutputFormat format, const FileResult& file) {
    for (const Finding& f : file.findings) {
        const bool note = tagStartsWithLineBreak(f.message);
        if (format == OutputFormat::Text) {
            out << escapeControls(f.file) << ": " << kindName(f.kind) << ": "
                << escapeControls(f.message) << '\n';
            if (note) out << escapeControls(f.file) << ": note: " << kLineBreakNote << '\n';
            continue;
        }
        out << "{\"file\":" << jsonString(f.file) << ",\"kind\":" << f.kind
            << ",\"kind_name\":" << jsonString(kindName(f.kind))
            << ",\"message\":" << jsonString(f.message) << ",\"source\":" << jsonString(file.source)
            << ",\"result\":" << file.result;
        if (note) out << ",\"note\":" << jsonString(kLineBreakNote);
        out << "}\n";
    }
}

void printSummary(std::ostream& out, OutputFormat format, const Summary& s) {
    if (format == OutputFormat::Text) {
        out << "kxvalidate: " << s.files << (s.files == 1 ? " file, " : " files, ") << s.findings
            << (s.findings == 1 ? " finding, " : " findings, ") << s.notValidated
            << " not validated\n";
        return;
    }
    out << "{\"summary\":{\"files\":" << s.files << ",\"findings\":" << s.findings
        << ",\"not_validated\":" << s.notValidated << "}}\n";
}
