#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

/// Gives every file named on the command line to the fuzzer's function once, each in a heap block
/// of exactly its size.
int main(int argc, char** argv) {
    for (int i = 1; i < argc; ++i) {
        std::ifstream file(argv[i], std::ios::binary);
        if (!file) {
            std::fprintf(stderr, "%s: cannot be read\n", argv[i]);
            return 1;
        }
        std::vector<char> read((std::istreambuf_iterator<char>(file)),
                               std::istreambuf_iterator<char>());
        const std::vector<std::uint8_t> bytes(read.begin(), read.end());
        LLVMFuzzerTestOneInput(bytes.data(), bytes.size());
    }
    return 0;
}
