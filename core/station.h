// The surveying mathematics of a station and the routines of its records.
#pragma once

#include <span>
#include <string_view>

#include "core/numbers.h"
#include "core/state.h"

namespace kavu {

// A packed angle's magnitude in decimal degrees, as gocdo decodes it.
double PackedDegrees(double packed);
// Decodes the packed angle in goc, checks it and the distance s, reports entry
// errors against TenDiem.
void gocdo(RunState& st);
// StGoc = the text of goc (decimal degrees).
void GocString(RunState& st);

// The masks of a computed point's X, Y, height, prism height and distance as
// the products write them, and the texts.
inline constexpr NumberMask kNorthingMask = ReadMask("#######.000");
inline constexpr NumberMask kEastingMask = ReadMask("######.000");
inline constexpr NumberMask kHeightMask = ReadMask("######.000");
inline constexpr NumberMask kPrismMask = ReadMask("####.000");
inline constexpr NumberMask kDistanceMask = ReadMask("#####.000");
std::string NorthingText(double x);
std::string EastingText(double y);
std::string HeightText(double z);

// Azimuth and distance from the orientation point to the station.
void TinhPhuongViCanh(RunState& st);
// Height of the current point from its zenith angle.
void TinhDoCao(RunState& st);
// Plane coordinates of the current point.
void TinhToaDo(RunState& st);

// A name longer than its 12-character field is reported (in full) before the
// field cuts it.
void ReportLongName(RunState& st, std::string_view name);

// What a record of a station's body is, from its fields: a check sight
// (7 fields, the last "KT"), a peg or an orientation distance (6 or 7 fields,
// the sixth a name of 3 characters or more that is not a number), a detail
// point (5 fields, or 6 or 7 otherwise), too few fields to be any (two
// records run together, or the next station's), or more than 7.
enum class BodyRecord { Detail, Peg, Check, TooFew, TooMany };
BodyRecord BodyRecordOf(std::span<const std::string_view> fields);

// A packed angle of more than 7 characters cannot be a DDDMMSS reading.
bool ReadingTooLong(std::string_view reading);
// Reports the first peg of the station just computed (its points from
// firstPoint on) whose reading cannot be a DDDMMSS reading: it ends the
// station's block in the peg file. Only when the peg file is ticked.
void CheckPegReadings(RunState& st, std::size_t firstPoint);

// The routines of a station's body records: a detail point radiated; a peg
// radiated and made a known point, or an orientation distance checked; a
// check sight on another known point.
void ComputeDetailRecord(RunState& st);
void ComputePegRecord(RunState& st);
void ComputeCheckRecord(RunState& st);

}  // namespace kavu
