// Runs a fuzz target over the files it is given (or the files of the
// directories it is given), as libFuzzer replays a corpus: in the ordinary
// and the sanitizer builds, every input that once found a fault runs again.

#include <dirent.h>
#include <sys/stat.h>

#include <cstdint>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);

static int replay(const std::string& path)
{
    std::ifstream in(path.c_str(), std::ios::binary);
    std::vector<char> bytes((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    LLVMFuzzerTestOneInput(reinterpret_cast<const uint8_t*>(bytes.data()), bytes.size());
    return 1;
}

int main(int argc, char** argv)
{
    int files = 0;
    for (int i = 1; i < argc; i++)
    {
        struct stat st;
        if (stat(argv[i], &st) != 0)
        {
            fprintf(stderr, "%s: no such file or directory\n", argv[i]);
            return 2;
        }
        if (!S_ISDIR(st.st_mode))
        {
            files += replay(argv[i]);
            continue;
        }
        DIR* d = opendir(argv[i]);
        while (dirent* e = d ? readdir(d) : nullptr)
            if (e->d_name[0] != '.')
                files += replay(std::string(argv[i]) + "/" + e->d_name);
        if (d)
            closedir(d);
    }
    printf("%d inputs ran\n", files);
    return 0;
}
