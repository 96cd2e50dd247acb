// The read limit: what merely reading a file costs. Reads in 16 KiB blocks and counts
// field separators, printing the count so the work cannot be optimised away.
#include <fcntl.h>
#include <unistd.h>

#include <cstdint>
#include <cstdio>
#include <cstring>

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: readlimit FILE\n");
        return 2;
    }
    const int fd = open(argv[1], O_RDONLY);
    if (fd < 0) {
        std::perror(argv[1]);
        return 2;
    }
    static char buffer[16384];
    uint64_t separators = 0;
    for (ssize_t n; (n = read(fd, buffer, sizeof buffer)) > 0;) {
        const char* p = buffer;
        const char* end = buffer + n;
        while ((p = static_cast<const char*>(std::memchr(p, '\x01', end - p))) != nullptr) {
            ++separators;
            ++p;
        }
    }
    close(fd);
    std::printf("%llu\n", static_cast<unsigned long long>(separators));
    return 0;
}
