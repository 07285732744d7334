// Plays random lives of the diagnostic on the headless screen or the television's: keys, texts, power changes,
// changing air, delays and faults, until something is broken or the events are used up.
//
//   monkey [--mode stepped|threaded|television] [--seed N] [--events N]   so many events, in lives of their own seeds
//   monkey [--mode ...] --life N                                          one life again

#include <cstdlib>
#include <functional>
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

using Play = std::function<int(std::uint64_t, int)>;

Play playOf(const std::string& mode) {
    using namespace wp::monkey;
    if (mode == "threaded") return playThreadedLife;
#ifdef WP_MONKEY_TELEVISION
    if (mode == "television") return playTelevisionLife;
#endif
    if (mode == "stepped")
        return [](std::uint64_t seed, int events) { return playSteppedLife(seed, events, watchedHeadless); };
    std::cerr << "monkey: --mode: \"" << mode << "\" is none that this build can play\n";
    std::exit(2);
}

}  // namespace

int main(int argc, char** argv) {
    const Options options = read(argc, argv);
    const Play play = playOf(options.mode);
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
