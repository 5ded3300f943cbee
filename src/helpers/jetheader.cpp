#include "helpers/jetheader.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>
#include <fcntl.h>
#include <numeric>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace jet
{

namespace
{

using Bytes = std::array<unsigned char, 0xA0>;

// Behind the version most of the header is hidden, with the same key in every file. The date of
// creation hides the password once more, from Jet 4 on.
constexpr std::size_t nameAt = 4, versionAt = 0x14, hiddenFrom = 0x18;
constexpr std::size_t codePageAt = 0x3C, keyAt = 0x3E, passwordAt = 0x42, dateAt = 0x72;
constexpr std::size_t hidden[] = {126, 128}, passwordSize[] = {20, 40}; // Jet 3, Jet 4
constexpr std::array<unsigned char, 4> headerKey = {0xC7, 0xDA, 0x39, 0x6B};

class File
{
public:
    explicit File(const std::string &name)
        : mHandle(open(name.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC))
    {
    }
    ~File()
    {
        if (mHandle >= 0)
            close(mHandle);
    }
    File(const File &) = delete;
    File &operator=(const File &) = delete;

    bool isOpen() const { return mHandle >= 0; }
    bool look(struct stat &about) const { return fstat(mHandle, &about) == 0; }
    std::size_t readInto(Bytes &bytes) const
    {
        return std::size_t(std::max<ssize_t>(0, pread(mHandle, bytes.data(), bytes.size(), 0)));
    }

private:
    int mHandle;
};

void rc4(unsigned char *bytes, std::size_t size)
{
    std::array<unsigned char, 256> state;
    std::iota(state.begin(), state.end(), 0);
    unsigned char j = 0;
    for (unsigned i = 0; i < state.size(); ++i) {
        j = (unsigned char)(j + state[i] + headerKey[i % headerKey.size()]);
        std::swap(state[i], state[j]);
    }
    unsigned char i = 0;
    j = 0;
    for (std::size_t n = 0; n < size; ++n) {
        j = (unsigned char)(j + state[++i]);
        std::swap(state[i], state[j]);
        bytes[n] ^= state[(unsigned char)(state[i] + state[j])];
    }
}

bool hasName(const Bytes &bytes, std::string_view name)
{
    return std::memcmp(bytes.data() + nameAt, name.data(), name.size()) == 0;
}

bool isProtected(const Bytes &bytes, bool jet4)
{
    const auto *key = bytes.data() + keyAt;
    if (std::any_of(key, key + 4, [](unsigned char c) { return c != 0; }))
        return true;
    double created = 0;
    std::memcpy(&created, bytes.data() + dateAt, sizeof created);
    const bool plausible = jet4 && created > -1e9 && created < 1e9;
    const auto mask = std::uint32_t(plausible ? std::int32_t(created) : 0);
    for (std::size_t i = 0; i < passwordSize[jet4]; ++i) {
        if (bytes[passwordAt + i] != (unsigned char)(mask >> 8 * (i % 4)))
            return true;
    }
    return false;
}

Result judge(Bytes &bytes, std::size_t size, Header &header)
{
    constexpr std::string_view own = "SQLite format 3";
    if (std::memcmp(bytes.data(), own.data(), own.size()) == 0)
        return Result::OwnFormat;
    if (hasName(bytes, "Standard ACE DB"))
        return Result::NewerFormat;
    if (!hasName(bytes, "Standard Jet DB"))
        return Result::NotADatabase;
    const bool jet4 = bytes[versionAt] == 1;
    if (bytes[versionAt] > 1)
        return Result::NewerFormat;
    header.generation = jet4 ? 4 : 3;
    header.pageSize = jet4 ? 4096 : 2048;
    header.pages = size / header.pageSize;
    if (size % header.pageSize != 0 || size < header.pageSize)
        return Result::CutOff;
    rc4(bytes.data() + hiddenFrom, hidden[jet4]);
    header.codePage = bytes[codePageAt] | bytes[codePageAt + 1] << 8;
    return isProtected(bytes, jet4) ? Result::Protected : Result::Read;
}

} // namespace

Result readHeader(const std::string &name, Header &header)
{
    const File file(name);
    struct stat about = {};
    if (!file.isOpen() || !file.look(about))
        return Result::NotOpened;
    if (!S_ISREG(about.st_mode))
        return Result::NotAFile;
    Bytes bytes = {};
    file.readInto(bytes);
    return judge(bytes, std::size_t(about.st_size), header);
}

} // namespace jet
