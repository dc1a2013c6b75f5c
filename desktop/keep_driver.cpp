#include "desktop/keep_driver.h"

#include <dlfcn.h>
#include <link.h>

#include <string_view>

void keepDriverLoaded() {
    const auto keep = [](dl_phdr_info* info, std::size_t, void*) {
        const std::string_view name = info->dlpi_name;
        for (const char* part : {"libEGL", "libgl", "_dri.so"}) {
            if (name.find(part) != name.npos) dlopen(info->dlpi_name, RTLD_LAZY | RTLD_NOLOAD | RTLD_NODELETE);
        }
        return 0;
    };
    dl_iterate_phdr(keep, nullptr);
}
