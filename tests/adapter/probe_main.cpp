// Loads the probe module the way a CIM server loads the provider module and
// prints, one "key=value" a line, what its start-up left behind.
//
//   adapter_probe [--fault entry=kind] <module>
//
// The environment (HOME, LD_LIBRARY_PATH, DTRUJ_HOST) is the caller's. A
// fault is set in the simulated library before the module loads, so that it
// meets the start-up; the module then finds the library loaded by its name.

#include <dlfcn.h>
#include <stdio.h>
#include <string.h>

#include <string>

template<class F>
static F find(void* handle, const char* name)
{
    return handle ? (F)dlsym(handle, name) : 0;
}

int main(int argc, char** argv)
{
    int arg = 1;

    if (argc == 4 && strcmp(argv[1], "--fault") == 0)
    {
        std::string entry(argv[2]);
        size_t eq = entry.find('=');
        void* lib = dlopen("libdtruj.so", RTLD_NOW | RTLD_GLOBAL);
        auto setFault = find<int (*)(const char*, const char*)>(lib, "dtruj_sim_set_fault");

        if (eq == std::string::npos || !setFault ||
            setFault(entry.substr(0, eq).c_str(), entry.substr(eq + 1).c_str()) != 0)
            return 2;

        arg = 3;
    }

    if (arg + 1 != argc)
        return 2;

    void* module = dlopen(argv[arg], RTLD_NOW | RTLD_LOCAL);
    printf("loaded=%d\n", module ? 1 : 0);

    if (!module)
        return 1;

    int libraryLoaded = find<int (*)()>(module, "probe_library_loaded")();
    printf("libraryLoaded=%d\n", libraryLoaded);
    printf("driverStatus=%d\n", find<int (*)()>(module, "probe_driver_status")());

    char unbound[4096];
    printf("bound=%d\n", find<int (*)(char*, size_t)>(module, "probe_bound_entries")(
        unbound, sizeof(unbound)));
    printf("unbound=%s\n", unbound);

    // Calling every entry of a real library would set things going in it.
    if (!libraryLoaded)
        printf("stubs=%d\n", find<int (*)()>(module, "probe_stub_answers")());

    fflush(stdout);
    return 0;
}
