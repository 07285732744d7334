// Runs a fuzz target over the files of its corpus folders, without libFuzzer: each file as it stands, cut short at
// every length, and with each of its first bytes flipped.

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <iterator>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

// A long dump is cut at its first bytes only: a cut further on meets the same code again.
constexpr std::size_t longestCut = 2048;

void run(const std::vector<std::uint8_t>& bytes, std::size_t size) {
    // A copy of exactly that size, so that a sanitizer sees a read behind its end.
    const std::vector<std::uint8_t> exact(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(size));
    LLVMFuzzerTestOneInput(exact.data(), exact.size());
}

void replay(std::vector<std::uint8_t> bytes) {
    run(bytes, bytes.size());
    const std::size_t end = std::min(bytes.size(), longestCut);
    for (std::size_t size = 0; size < end; ++size) {
        run(bytes, size);
    }
    for (std::size_t i = 0; i < end; ++i) {
        bytes[i] ^= 0xFF;
        run(bytes, std::min(bytes.size(), longestCut));
        bytes[i] ^= 0xFF;
    }
}

}  // namespace

int main(int count, char** arguments) {
    std::size_t files = 0;
    for (int i = 1; i < count; ++i) {
        for (const auto& entry : std::filesystem::recursive_directory_iterator(arguments[i])) {
            if (entry.is_regular_file() && entry.path().filename() != "README.md") {
                std::ifstream file(entry.path(), std::ios::binary);
                replay({std::istreambuf_iterator<char>(file), {}});
                ++files;
            }
        }
    }
    std::cout << files << " files replayed\n";
    // A target without its corpus tests nothing.
    return files == 0 ? 1 : 0;
}
