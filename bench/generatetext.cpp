#include "generate.h"
#include "names.h"

#include <fstream>
#include <stdexcept>

namespace
{

/// Writes discs in one of the four formats. They differ in two things: whether the artist stands at
/// the head or with each track, and whether the fields of a track have a row each or share one.
class TextWriter
{
public:
    TextWriter(char format, std::ostream &out, int tracks, std::uint64_t seed)
        : mAlbums(format == 'B' || format == 'D'),
          mNested(format == 'A' || format == 'B'),
          mOut(out),
          mLeft(tracks),
          mNames(seed),
          mArtists(mNames.artists(std::size_t(std::max(20, tracks / 25)))),
          mPlaces(mArtists.size(), 10, 0.9)
    {
    }

    void run()
    {
        while (mLeft > 0)
            writeTitle();
    }

private:
    Random &random() { return mNames.random; }
    const std::string &artist() { return mArtists[mPlaces.pick(random())]; }

    void writeTitle()
    {
        std::string title = mNames.title();
        if (title == mPrevious) // equal neighbours would be one CD in the formats with one row
            title += " II";
        mPrevious = title;
        if (mAlbums)
            mOut << artist() << '\n';
        mOut << title << '\n';
        const int discs = mLeft > 100 && random().chance(0.08) ? random().between(2, 6) : 1;
        if (mNested)
            mOut << discs << '\n';
        for (int disc = 1; disc <= discs; ++disc)
            writeDisc(disc == discs);
    }

    void writeDisc(bool last)
    {
        const int tracks = std::min(mLeft, random().between(11, 19));
        mLeft -= tracks;
        if (mNested)
            mOut << tracks << '\n';
        for (int i = 0; i < tracks; ++i)
            writeTrack();
        if (!mNested && !last)
            mOut << "*\n";
    }

    void writeTrack()
    {
        const char separator = mNested ? '\n' : '*';
        const char *missing = mNested ? "*" : "";
        if (mAlbums) {
            mOut << mNames.title() << separator;
        } else {
            // Hits stand on more than one compilation.
            if (mSeen.empty() || !random().chance(0.2))
                mSeen.push_back(artist() + separator + mNames.title());
            else
                std::swap(mSeen[std::size_t(random().between(0, int(mSeen.size()) - 1))],
                          mSeen.back());
            mOut << mSeen.back() << separator;
        }
        mOut << (random().chance(0.93) ? mNames.genre() : missing) << separator;
        mOut << (random().chance(0.95) ? std::to_string(mNames.year()) : missing) << '\n';
    }

    bool mAlbums, mNested;
    std::ostream &mOut;
    int mLeft;
    Names mNames;
    std::vector<std::string> mArtists;
    Zipf mPlaces;
    std::string mPrevious;
    std::vector<std::string> mSeen; // "artist, separator, title" of compilations
};

} // namespace

void generateText(char format, const std::string &file, int tracks, std::uint64_t seed)
{
    std::ofstream out(file, std::ios::binary);
    TextWriter(format, out, tracks, seed).run();
    out.close();
    if (!out)
        throw std::runtime_error("cannot write " + file);
}
