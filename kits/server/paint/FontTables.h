// FontTables: what the font engine remembers: runs of glyphs and their images.
#pragma once

#include <atomic>
#include <memory>
#include <mutex>
#include <shared_mutex>
#include <string.h>
#include <string>
#include <string_view>
#include <unordered_map>

#include "server/paint/FontEngine.h"
#include "server/paint/FontList.h"

namespace BPrivate {

struct FaceCharacter;


// How far a glyph takes the pen on, and where it stands.
enum class Spacing : uint8 {
	Outlines, // by the outline's own measure
	Adjusted, // so, but each glyph stands on the whole pixel next to its place
	Fixed // all by one measure
};

struct RunKey {
	uint32 code;
	float size;
	Spacing spacing;
	std::string_view text;

	bool operator==(const RunKey& other) const = default;
};

struct OwnedRunKey {
	uint32 code;
	float size;
	Spacing spacing;
	std::string text;

	operator RunKey() const { return { code, size, spacing, text }; }
};

struct RunKeyHash {
	using is_transparent = void;
	size_t operator()(const RunKey& key) const
	{
		uint32 size;
		memcpy(&size, &key.size, sizeof(size));
		return std::hash<std::string_view>()(key.text)
			^ ((size_t)key.code << 32 | size) * (0x9e3779b1 + 2 * (size_t)key.spacing);
	}
	size_t operator()(const OwnedRunKey& key) const { return (*this)((RunKey)key); }
};

struct RunKeyEqual {
	using is_transparent = void;
	template<typename A, typename B> bool operator()(const A& a, const B& b) const
	{
		return (RunKey)a == (RunKey)b;
	}
};

using RunMap =
	std::unordered_map<OwnedRunKey, std::shared_ptr<const GlyphRun>, RunKeyHash, RunKeyEqual>;


// The images of one face at one size. Reading takes no lock.
class Strike {
public:
	static constexpr uint32 kPageGlyphs = 32;

	struct Page {
		std::atomic<const GlyphImage*> images[kPageGlyphs * FontEngine::kPhases] = {};
	};

	// A place for each glyph number there can be.
	std::atomic<Page*> pages[65536 / kPageGlyphs] = {};
};

struct StrikeKey {
	const GlyphFace* face;
	int32 size26_6;
	bool smooth;

	bool operator==(const StrikeKey& other) const = default;
};

struct StrikeKeyHash {
	size_t operator()(const StrikeKey& key) const
	{
		return ((size_t)key.face >> 4) * 31 + key.size26_6 * 2 + key.smooth;
	}
};


struct FontEngine::Tables {
	FontList list;
	std::mutex lock; // faces, runs
	RunMap runs;
	RunMap olderRuns;
	std::shared_mutex strikeLock;
	std::unordered_map<StrikeKey, std::unique_ptr<Strike>, StrikeKeyHash> strikes;
	std::atomic<size_t> imageBytes = 0;

	const FaceCharacter& Character(const GlyphFace& face, uint32 character);
	float Advance(const GlyphFace& face, const FaceCharacter& character, const RunKey& key);
	// Calls with every character in the order of drawing, its index in the text, and whether it is
	// a mark that stands above or below the letter before it.
	template<typename Use>
	void ForEach(const GlyphFace& face, std::string_view text, const Use& use);
	std::shared_ptr<GlyphRun> MakeRun(const RunKey& key);
	float Measure(const RunKey& key);
	Strike* StrikeFor(const StrikeKey& key);
	std::shared_ptr<const GlyphRun> FindRun(const RunKey& key);
};


} // namespace BPrivate
