// The viewer's scene loader on any text: it loads, or refuses with the one-line message
// "fuzz.json: PLACE: expected WHAT"; nothing escapes it.
#include <string>

#include "fuzz_reader.h"
#include "scene.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    Scene scene;
    std::string error;
    if (!ParseScene(std::string(reinterpret_cast<const char*>(data), size), "fuzz.json", "/nonexistent/", scene, error))
        FUZZ_CHECK(error.rfind("fuzz.json: ", 0) == 0 && error.find(": expected ") != std::string::npos &&
                   error.find('\n') == std::string::npos);
    return 0;
}
