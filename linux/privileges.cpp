#include "linux/privileges.h"

#include <sys/capability.h>
#include <sys/prctl.h>

#include <memory>
#include <type_traits>

namespace wp {
namespace {

struct Free {
    void operator()(cap_t capabilities) const { cap_free(capabilities); }
};
using Capabilities = std::unique_ptr<std::remove_pointer_t<cap_t>, Free>;

bool permits(const Capabilities& capabilities, cap_value_t capability) {
    cap_flag_value_t value = CAP_CLEAR;
    return capabilities && cap_get_flag(capabilities.get(), capability, CAP_PERMITTED, &value) == 0 &&
           value == CAP_SET;
}

}  // namespace

void dropPrivileges() {
    const cap_value_t scan = CAP_NET_ADMIN;
    const bool mayScan = permits(Capabilities(cap_get_proc()), scan);
    // Bounding and ambient sets first: shrinking them is a privilege of its own.
    for (cap_value_t each = 0; each <= cap_max_bits(); ++each) cap_drop_bound(each);
    prctl(PR_CAP_AMBIENT, PR_CAP_AMBIENT_CLEAR_ALL, 0, 0, 0);
    const Capabilities kept(cap_init());
    if (mayScan && kept) {
        cap_set_flag(kept.get(), CAP_PERMITTED, 1, &scan, CAP_SET);
        cap_set_flag(kept.get(), CAP_EFFECTIVE, 1, &scan, CAP_SET);
    }
    if (kept) cap_set_proc(kept.get());
    prctl(PR_SET_NO_NEW_PRIVS, 1, 0, 0, 0);
}

}  // namespace wp
