#pragma once

#include "base/memory.h"
#include "tension/key_frame_list.h"
#include "tension/pack_file.h"
#include "tension/text_string.h"

#include <cstddef>
#include <cstdint>

namespace sound
{
class CSoundBuffer;
}

namespace tension
{

// The battle tension levels, a 32-bit integer wherever stored.
enum class TensionLevel : std::int32_t
{
    Low = 0,
    Normal = 1,
    Hi = 2,
    Climax = 3,
};

// The name the check's messages give a level: "LowTension", "NormalTension",
// "HiTension", "ClimaxTension".
const char* LevelMessageName(TensionLevel level);

// What the timeline check measures for one level, and the limits it holds
// the level to.
struct LevelTally
{
    float totalSeconds;
    int segments;
    // Whole seconds; kNoTimeLimit for the levels without one.
    int timeLimit;
    int segmentLimit;
};

inline constexpr int kNoTimeLimit = -1;
// The music a tension file is checked against lasts this many seconds.
inline constexpr float kShortestMusic = 60.0f;
inline constexpr float kLongestMusic = 480.0f;
inline constexpr int kTensionLevelCount = 4;

// One tally per level, indexed by the level's value.
struct TimelineTally
{
    LevelTally levels[kTensionLevelCount];
};

// A tension file: a timeline of tension levels over one piece of music, an
// optional climax-finale mark, a display name and a comment, parsed from
// code page 932 text and validated against the music's length. Messages go
// to a caller's log (which may be null), each ending with a line feed.
//
// The Parse scan never reads past the zero that ends the text: a lead byte
// whose trail would be that zero ends the scan as the zero does (in the key
// scan, in the value readers, in the skip after an unrecognised key, in the
// comment skips and in the character passed over after an entry).
class CTensionFile : public base::CAllocated
{
public:
    // One key or one value is collected in this many bytes with its zero. A
    // longer key names nothing; a longer file name or comment is cut (at a
    // character boundary) to its first kValueCapacity - 1 bytes, which fails
    // the checks as the whole would; a longer time reads as a failed read.
    static constexpr std::size_t kKeyCapacity = 260;
    static constexpr std::size_t kValueCapacity = 260;

    CTensionFile();
    CTensionFile(const CTensionFile& other);
    CTensionFile& operator=(const CTensionFile&) = delete;

    // Virtual operations in slot order.
    virtual ~CTensionFile();
    virtual bool LoadFromArchive(sound::CSoundBuffer* sound, const char* entryName,
                                 const CqvxPackFile* archive, CTextString* log);
    virtual bool LoadFromArchiveList(sound::CSoundBuffer* sound, const char* entryName,
                                     const CqvxPackFileList& archives, CTextString* log);
    virtual bool LoadFromFile(sound::CSoundBuffer* sound, const char* path, CTextString* log);
    virtual bool Parse(sound::CSoundBuffer* sound, const char* text, char separator,
                       char terminator, CTextString* log);
    virtual bool IsFileNameKey(const char* key);
    virtual bool ReadFileName(const char* text, char terminator, std::size_t* position);
    virtual bool IsCommentKey(const char* key);
    virtual bool ReadComment(const char* text, char terminator, std::size_t* position);
    virtual float ReadTime(const char* text, char terminator, std::size_t* position);
    virtual int GetTensionIndex(const char* key);
    virtual bool IsFinaleKey(const char* key);
    virtual bool ReleaseTimeline();
    virtual bool IsCorrect(sound::CSoundBuffer* sound, CTextString* log);
    virtual bool CheckFileName(sound::CSoundBuffer* sound, CTextString* log);
    virtual bool CheckComment(sound::CSoundBuffer* sound, CTextString* log);
    virtual bool CheckTimeline(sound::CSoundBuffer* sound, CTextString* log);
    virtual TensionLevel GetTension(float time);

    // Whether the climax finale plays at `time`.
    bool IsFinale(float time);

    // Parse of a text for music of `length` seconds (no sound buffer needed:
    // fuzz targets and tests).
    bool ParseForLength(float length, const char* text, char separator, char terminator,
                        CTextString* log);

    sound::CSoundBuffer* GetSound() const { return sound_; }
    const CTextString& GetName() const { return name_; }
    const CTextString& GetComment() const { return comment_; }
    float GetLoopStart() const { return loopStart_; }
    void SetLoopStart(float loopStart) { loopStart_ = loopStart; }
    float GetFinaleTime() const { return finaleTime_; }
    float GetFinaleWindow() const { return finaleWindow_; }
    // Null until the first parse.
    const CKeyFrameList* GetTimeline() const { return timeline_; }
    // What CheckTimeline weighs against music of `length` seconds: the
    // totals and segment counts of the present timeline and their limits.
    // Authors' tools read it after a check to say by how much a file fails.
    TimelineTally TallyTimeline(float length) const;

private:
    // Steps 1 to 4 of Parse: false when the text is null, the timeline
    // cannot be made or a "/*" comment is not closed; else the finale count.
    bool Scan(float length, const char* text, char separator, char terminator, CTextString* log,
              int* finaleCount);
    // Step 5 of Parse, given the result of the checks.
    static bool Finish(bool checked, int finaleCount, CTextString* log);
    static bool CheckLength(float length, CTextString* log);
    // A value from `position` to the next terminator, trimmed, into `value`
    // (kValueCapacity bytes); `cut` tells whether it had to be cut. False at
    // the end of the text, `position` then at its end.
    static bool ReadValue(const char* text, char terminator, std::size_t* position, char* value,
                          bool* cut);
    bool CheckTimelineFor(float length, CTextString* log);
    float FoldTime(float time) const;

    sound::CSoundBuffer* sound_ = nullptr;
    CTextString name_;
    CTextString comment_;
    float loopStart_ = 0.0f;
    float finaleTime_ = 0.0f;
    float finaleWindow_ = 0.0f;
    CKeyFrameList* timeline_ = nullptr;
};

} // namespace tension
