// Plays random lives of the diagnostic on the headless screen: keys, texts, power changes, changing air,
// delays and faults, until something is broken or the events are used up.
//
//   monkey [--mode stepped|threaded] [--seed N] [--events N]   so many events, in lives of their own seeds
//   monkey [--mode ...] --life N                                one life again

#include <cstdlib>
#include <iostream>
#include <string>

#include "verification/monkey/checks.h"
#include "verification/monkey/life.h"

namespace {

constexpr int kEventsOfALife = 400;

struct Options {
    std::string mode = "stepped";
    std::uint64_t seed = 1;
    long events = 100'000;
    std::uint64_t life = 0;
};

Options read(int argc, char** argv) {
    Options options;
    for (int i = 1; i + 1 < argc; i += 2) {
        std::string name = argv[i];
        if (name == "--mode") options.mode = argv[i + 1];
        if (name == "--seed") options.seed = std::strtoull(argv[i + 1], nullptr, 10);
        if (name == "--events") options.events = std::strtol(argv[i + 1], nullptr, 10);
        if (name == "--life") options.life = std::strtoull(argv[i + 1], nullptr, 10);
    }
    return options;
}

}  // namespace

int main(int argc, char** argv) {
    const Options options = read(argc, argv);
    auto play = options.mode == "threaded" ? wp::monkey::playThreadedLife : wp::monkey::playSteppedLife;
    long played = 0;
    int lives = 0;
    std::uint64_t life = options.life ? options.life : options.seed * 1'000'000;
    try {
        for (; played < options.events; ++life, ++lives) {
            played += play(life, kEventsOfALife) + 1;
            if (options.life) break;
        }
    } catch (const wp::monkey::Broken& broken) {
        std::cerr << "monkey: life " << life << ", " << broken.what() << "\n"
                  << "monkey: play it again with --mode " << options.mode << " --life " << life << "\n";
        return 1;
    }
    std::cout << "monkey: " << played << " events in " << lives << " lives, nothing broken\n";
    return 0;
}
