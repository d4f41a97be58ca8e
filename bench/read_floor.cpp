// read_floor: how fast expat alone gets through a file, fed the way the
// CIM-XML reader feeds it (1 MiB buffers) with handlers that only count.
// What the loader spends beyond this is the cost of building the repository.
//
//   read_floor FILE.xml

#include <expat.h>

#include <cerrno>
#include <chrono>
#include <cstdio>
#include <cstring>

namespace {

struct TCounts {
    unsigned long long fElements = 0;
    unsigned long long fTextBytes = 0;
};

void XMLCALL OnStart(void* data, const XML_Char*, const XML_Char**) { ++static_cast<TCounts*>(data)->fElements; }
void XMLCALL OnEnd(void*, const XML_Char*) {}
void XMLCALL OnText(void* data, const XML_Char*, int length) {
    static_cast<TCounts*>(data)->fTextBytes += static_cast<unsigned>(length);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: read_floor FILE.xml\n");
        return 2;
    }
    std::FILE* file = std::fopen(argv[1], "rb");
    if (!file) {
        std::fprintf(stderr, "read_floor: cannot open %s: %s\n", argv[1], std::strerror(errno));
        return 1;
    }
    XML_Parser parser = XML_ParserCreate(nullptr);
    TCounts counts;
    XML_SetUserData(parser, &counts);
    XML_SetElementHandler(parser, OnStart, OnEnd);
    XML_SetCharacterDataHandler(parser, OnText);
    XML_SetParamEntityParsing(parser, XML_PARAM_ENTITY_PARSING_NEVER);

    const int kChunk = 1 << 20;
    unsigned long long bytes = 0;
    const auto start = std::chrono::steady_clock::now();
    for (;;) {
        void* buffer = XML_GetBuffer(parser, kChunk);
        const size_t read = buffer ? std::fread(buffer, 1, kChunk, file) : 0;
        bytes += read;
        if (!buffer || XML_ParseBuffer(parser, static_cast<int>(read), read == 0) == XML_STATUS_ERROR) {
            std::fprintf(stderr, "read_floor: %s:%lu: %s\n", argv[1], XML_GetCurrentLineNumber(parser),
                         XML_ErrorString(XML_GetErrorCode(parser)));
            return 1;
        }
        if (read == 0) break;
    }
    const double wall = std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    XML_ParserFree(parser);
    std::fclose(file);

    std::printf("file size: %llu bytes\n", bytes);
    std::printf("wall time: %.3f s\n", wall);
    std::printf("throughput: %.1f MB/s\n", wall > 0 ? static_cast<double>(bytes) / 1e6 / wall : 0.0);
    std::printf("elements: %llu\n", counts.fElements);
    std::printf("text bytes: %llu\n", counts.fTextBytes);
    return 0;
}
