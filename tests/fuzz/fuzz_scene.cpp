// The viewer's scene loader on any text: it loads, or refuses with the one-line message
// "fuzz.json: PLACE: expected WHAT"; nothing escapes it.
#include <string>

#include "fuzz_reader.h"
#include "scene.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    const std::string text(reinterpret_cast<const char*>(data), size);
    Scene scene;
    std::string error;
    if (!ParseScene(text, "fuzz.json", "/nonexistent/", scene, error)) {
        FUZZ_CHECK(error.rfind("fuzz.json: ", 0) == 0 && error.find(": expected ") != std::string::npos);
        FUZZ_CHECK(error.find('\n') == std::string::npos);
    }
    return 0;
}
