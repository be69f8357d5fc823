// Loads the probe module the way a CIM server loads the provider module and
// reports, one "key=value" per line, what its start-up left behind.
//
//   adapter_probe [--fault entry=kind ...] <module> [bound] [stubs]
//
// The environment (HOME, LD_LIBRARY_PATH, DTRUJ_HOST) is the caller's. A
// fault is set in the simulated library before the module loads, so that it
// meets the module's start-up; the module then finds the library already
// loaded under its name.

#include <dlfcn.h>
#include <stdio.h>
#include <string.h>

int main(int argc, char** argv)
{
    int arg = 1;

    for (; arg + 1 < argc && strcmp(argv[arg], "--fault") == 0; arg += 2)
    {
        char entry[256];
        snprintf(entry, sizeof(entry), "%s", argv[arg + 1]);
        char* kind = strchr(entry, '=');

        if (!kind)
            return 2;

        *kind++ = '\0';

        void* lib = dlopen("libdtruj.so", RTLD_NOW | RTLD_GLOBAL);
        int (*setFault)(const char*, const char*) = lib ?
            (int (*)(const char*, const char*))dlsym(lib, "dtruj_sim_set_fault") : 0;

        if (!setFault || setFault(entry, kind) != 0)
        {
            printf("fault=failed\n");
            return 1;
        }
    }

    if (arg >= argc)
    {
        fprintf(stderr, "usage: %s [--fault entry=kind ...] <module> [bound] [stubs]\n",
            argv[0]);
        return 2;
    }

    void* module = dlopen(argv[arg], RTLD_NOW | RTLD_LOCAL);

    if (!module)
    {
        printf("loaded=0\nerror=%s\n", dlerror());
        return 1;
    }

    printf("loaded=1\n");

    int (*status)() = (int (*)())dlsym(module, "probe_driver_status");
    int (*libLoaded)() = (int (*)())dlsym(module, "probe_library_loaded");
    printf("driverStatus=%d\n", status());
    printf("libraryLoaded=%d\n", libLoaded());

    for (int i = arg + 1; i < argc; i++)
    {
        if (strcmp(argv[i], "bound") == 0)
        {
            int (*bound)(char*, size_t) =
                (int (*)(char*, size_t))dlsym(module, "probe_bound_entries");
            char unbound[4096];
            printf("bound=%d\n", bound(unbound, sizeof(unbound)));
            printf("unbound=%s\n", unbound);
        }
        else if (strcmp(argv[i], "stubs") == 0)
        {
            int (*stubs)() = (int (*)())dlsym(module, "probe_stub_answers");
            printf("stubs=%d\n", stubs());
        }
    }

    fflush(stdout);
    return 0;
}
