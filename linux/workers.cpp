#include "linux/workers.h"

namespace wp {

Workers::~Workers() {
    for (std::thread& each : threads_) each.join();
}

void Workers::start(std::function<Publication()> work) {
    const auto place = threads_.emplace(threads_.end());
    *place = std::thread([this, place, work = std::move(work)] {
        Publication publication = work();
        inbox_.post([this, place, publication = std::move(publication)] {
            place->join();
            threads_.erase(place);
            publication();
        });
    });
}

}  // namespace wp
