// The peer measured beside kxvalidate: splits the file into messages and validates each
// against the same FIX 4.4 data dictionary. Built only when the peer library is installed.
#include <quickfix/DataDictionary.h>
#include <quickfix/Message.h>

#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fprintf(stderr, "usage: peer_validate DICTIONARY FILE\n");
        return 2;
    }
    const FIX::DataDictionary dictionary(argv[1]);
    std::ifstream in(argv[2], std::ios::binary);
    const std::string data((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    size_t messages = 0;
    size_t invalid = 0;
    // A message ends with the separator after "10=" and its value.
    for (size_t start = 0; start < data.size();) {
        const size_t checksum = data.find(
            "\x01"
            "10=",
            start);
        if (checksum == std::string::npos) break;
        const size_t end = data.find('\x01', checksum + 4);
        if (end == std::string::npos) break;
        try {
            FIX::Message message(data.substr(start, end + 1 - start), dictionary, false);
            dictionary.validate(message);
        } catch (const std::exception&) {
            ++invalid;
        }
        ++messages;
        start = end + 1;
    }
    std::printf("%zu messages, %zu invalid\n", messages, invalid);
    return 0;
}
