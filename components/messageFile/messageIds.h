#pragma once

// Every numbered message of the library: its name in the code, its number and the arguments that callers pass.
//
//   d   a 32-bit integer       f   a double
//   c   a character            s   a wide string, or null for an empty one
//
// Texts: messages/<language>.msg, one for each number. Those of the first list stand around other texts, given as
// arguments, so that a user sees where a fault lies and what it is.

// clang-format off

// Wrappers and what any format reports.
#define OVPHOTO_MESSAGES_GENERAL(message) \
    message(naturalLightLine, 12896, "sd")  /* detail, line */ \
    message(nimbLine,         12897, "ds")  /* line, detail */ \
    message(webRefused,       12935, "") \
    message(outOfMemory,      12936, "") \
    message(fileNotRead,      12945, "s" )  /* detail */ \
    message(textSetOff,       13082, "s" )  /* the text */ \
    message(webNotSaved,      13083, "s" )  /* name of the web */

// Natural light, text form: the line that is missing or malformed. Put into 12896 as they stand.
#define OVPHOTO_MESSAGES_NATURAL_LIGHT(message) \
    message(lightHeader,                   12898, "") \
    message(lightOnOff,                    12899, "") \
    message(lightOnOffWord,                12900, "") \
    message(lightInOut,                    12901, "") \
    message(lightInOutWord,                12902, "") \
    message(lightNorth,                    12903, "") \
    message(lightLatitude,                 12904, "") \
    message(lightLongitude,                12905, "") \
    message(lightDay,                      12906, "") \
    message(lightDaylightSaving,           12907, "") \
    message(lightDaylightSavingWord,       12908, "") \
    message(lightLocalTime,                12909, "") \
    message(lightTimeZone,                 12910, "") \
    message(lightSkyCover,                 12911, "") \
    message(lightSunColor,                 12912, "") \
    message(lightSkyColor,                 12913, "") \
    message(lightOverwritePosition,        12914, "") \
    message(lightOverwritePositionWord,    12915, "") \
    message(lightSolarAltitude,            12916, "") \
    message(lightSolarAzimuth,             12917, "") \
    message(lightOverwriteIlluminance,     12918, "") \
    message(lightOverwriteIlluminanceWord, 12919, "") \
    message(lightDirectNormalIlluminance,  12920, "") \
    message(lightSkyCastsShadows,          12921, "") \
    message(lightSunFlags,                 12922, "") \
    message(lightSkyFlags,                 12923, "") \
    message(lightSkyShadowsAccuracy,       12924, "") \
    message(lightNotFinite,                13081, "s")  /* line; this one stands alone */

// Installing a web.
#define OVPHOTO_MESSAGES_WEB(message) \
    message(verticalAnglesNotAscending,   12925, "") \
    message(horizontalAnglesNotAscending, 12926, "") \
    message(firstHorizontalAngleNotZero,  12927, "") \
    message(fullRange,                    12928, "") \
    message(halfRange,                    12929, "") \
    message(quarterRange,                 12930, "") \
    message(axialCount,                   12931, "")

// IES: converting the record, by photometric type.
#define OVPHOTO_MESSAGES_IES_CONVERT(message) \
    message(typeAVerticalRange,        12932, "") \
    message(typeAHorizontalCount,      12933, "") \
    message(typeAHorizontalRange,      12934, "") \
    message(typeBVerticalRange,        12937, "") \
    message(typeBHorizontalCount,      12938, "") \
    message(typeBHorizontalRange,      12939, "") \
    message(typeCVerticalRange,        12940, "") \
    message(typeCLastHorizontalAngle,  12941, "f")  /* angle */ \
    message(typeCFirstHorizontalAngle, 12942, "f")  /* angle */ \
    message(verticalAnglesDecrease,    12943, "") \
    message(horizontalAnglesDecrease,  12944, "")

// IES and CIBSE: reading.
#define OVPHOTO_MESSAGES_READ(message) \
    message(numberNotConverted, 12946, "") \
    message(integerExpected,    12947, "c" )  /* character */ \
    message(floatExpected,      12948, "c" )  /* character */ \
    message(tiltGeometry,       12949, "d" )  /* value */ \
    message(tiltPairCount,      12950, "d" )  /* value */ \
    message(tiltFirstAngle,     12951, "f" )  /* angle */ \
    message(tiltAngleOrder,     12952, "ff")  /* previous angle, angle */ \
    message(tiltLastAngle,      12953, "f" )  /* angle */ \
    message(tiltAngles,         12954, "d" )  /* pairs */ \
    message(tiltFactors,        12955, "d" )  /* pairs */ \
    message(tiltLineMissing,    12956, "") \
    message(tiltFileNotFound,   12957, "s" )  /* name */ \
    message(tiltFileNotOpened,  12958, "s" )  /* path */ \
    message(lampCount,          12959, "d" )  /* value */ \
    message(verticalCount,      12960, "d" )  /* value */ \
    message(horizontalCount,    12961, "d" )  /* value */ \
    message(photometricType,    12962, "d" )  /* value */ \
    message(unitsType,          12963, "d" )  /* value */ \
    message(dimensions,         12964, "") \
    message(factors,            12965, "") \
    message(verticalAngle,      12966, "") \
    message(horizontalAngle,    12967, "") \
    message(candela,            12968, "")

// NIMB.
#define OVPHOTO_MESSAGES_NIMB(message) \
    message(nimbEndOfFile,           12970, "") \
    message(nimbHeaderFields,        12971, "d")  /* fields */ \
    message(nimbMagic,               12972, "") \
    message(nimbLastHorizontalAngle, 12973, "d")  /* angle */ \
    message(nimbLastVerticalAngle,   12974, "d")  /* angle */ \
    message(nimbHorizontalStep,      12975, "d")  /* step */ \
    message(nimbVerticalStep,        12976, "d")  /* step */ \
    message(nimbOrientation,         12977, "d")  /* angle */ \
    message(nimbSymmetryCode1,       12978, "d")  /* code */ \
    message(nimbSymmetryCode2,       12979, "d")  /* code */ \
    message(nimbLineFields,          12980, "d")  /* fields */ \
    message(nimbNotWritten,          12981, "")

// CIBSE.
#define OVPHOTO_MESSAGES_CIBSE(message) \
    message(cibseType2VerticalRange,        12982, "") \
    message(cibseType2HorizontalCount,      12983, "") \
    message(cibseType2HorizontalRange,      12984, "") \
    message(cibseType1VerticalRange,        12985, "") \
    message(cibseType1LastHorizontalAngle,  12986, "f")  /* angle */ \
    message(cibseType1FirstHorizontalAngle, 12987, "f")  /* angle */ \
    message(cibseFirstLine,                 12989, "") \
    message(cibseNinthNumber,               12990, "") \
    message(cibseTrailer,                   12991, "")

// TBT: descriptions of a token (of at most 63 characters each), wrappers, details.
#define OVPHOTO_MESSAGES_TBT(message) \
    message(tbtTokenNumber,            12993, "s"  )  /* the token */ \
    message(tbtTokenZeroFill,          12994, "s"  )  /* the token */ \
    message(tbtTokenEnd,               12995, "s"  )  /* the token */ \
    message(tbtTokenEndOfFile,         12996, "") \
    message(tbtTokenOther,             12997, "s"  )  /* the token */ \
    message(tbtSyntaxError,            12998, "dss")  /* line feeds, detail, token's description or null */ \
    message(tbtValueError,             12999, "ds" )  /* line feeds, detail */ \
    message(tbtResourceError,          13000, "d"  )  /* number of the message */ \
    message(tbtKindCodeMissing,        13002, "") \
    message(tbtKind4Value,             13003, "") \
    message(tbtKind5Second,            13004, "") \
    message(tbtKind5First,             13005, "") \
    message(tbtKind6Value,             13006, "") \
    message(tbtKindCode,               13007, "d"  )  /* code */ \
    message(tbtTripleRange,            13008, "fff")  /* the three values */ \
    message(tbtTripleMissing,          13009, "") \
    message(tbtFluxMissing,            13010, "") \
    message(tbtFlux,                   13011, "f"  )  /* flux */ \
    message(tbtReferenceFluxMissing,   13012, "") \
    message(tbtReferenceFlux,          13013, "f"  )  /* flux */ \
    message(tbtMultiplierMissing,      13014, "") \
    message(tbtAuxValue1Missing,       13015, "") \
    message(tbtAuxValue2Missing,       13016, "") \
    message(tbtAuxValue3Missing,       13017, "") \
    message(tbtSymmetryCodeMissing,    13018, "") \
    message(tbtSymmetryCode,           13019, "d"  )  /* code */ \
    message(tbtVerticalCountMissing,   13020, "") \
    message(tbtVerticalCount,          13021, "d"  )  /* count */ \
    message(tbtHorizontalCountMissing, 13022, "") \
    message(tbtHorizontalCount,        13023, "d"  )  /* count */ \
    message(tbtValueMissing,           13024, "") \
    message(tbtEndMissing,             13025, "")

// Names of the months.
#define OVPHOTO_MESSAGES_MONTHS(message) \
    message(monthJanuary,        13026, "") \
    message(monthJanuaryShort,   13027, "") \
    message(monthFebruary,       13028, "") \
    message(monthFebruaryShort,  13029, "") \
    message(monthMarch,          13030, "") \
    message(monthMarchShort,     13031, "") \
    message(monthApril,          13032, "") \
    message(monthAprilShort,     13033, "") \
    message(monthMay,            13034, "") \
    message(monthMayShort,       13080, "") \
    message(monthJune,           13035, "") \
    message(monthJuneShort,      13036, "") \
    message(monthJuly,           13037, "") \
    message(monthJulyShort,      13038, "") \
    message(monthAugust,         13039, "") \
    message(monthAugustShort,    13040, "") \
    message(monthSeptember,      13041, "") \
    message(monthSeptemberShort, 13042, "") \
    message(monthOctober,        13043, "") \
    message(monthOctoberShort,   13044, "") \
    message(monthNovember,       13045, "") \
    message(monthNovemberShort,  13046, "") \
    message(monthDecember,       13047, "") \
    message(monthDecemberShort,  13048, "")

// Names of the time zones; offsets in hours, west positive.
#define OVPHOTO_MESSAGES_ZONES(message) \
    message(zoneNewfoundland,     13054, "")  /* 3.5 */ \
    message(zoneAtlantic,         13055, "")  /* 4 */ \
    message(zoneEastern,          13056, "")  /* 5 */ \
    message(zoneCentral,          13057, "")  /* 6 */ \
    message(zoneMountain,         13058, "")  /* 7 */ \
    message(zonePacific,          13059, "")  /* 8 */ \
    message(zoneAlaska,           13060, "")  /* 9 */ \
    message(zoneHawaii,           13061, "")  /* 10 */ \
    message(zoneSamoa,            13062, "")  /* 11 */ \
    message(zoneNewZealand,       13063, "")  /* -12 */ \
    message(zoneSolomonIslands,   13049, "")  /* -11 */ \
    message(zoneEasternAustralia, 13064, "")  /* -10 */ \
    message(zoneCentralAustralia, 13065, "")  /* -9.5 */ \
    message(zoneJapan,            13066, "")  /* -9 */ \
    message(zoneChina,            13067, "")  /* -8 */ \
    message(zoneWesternAustralia, 13068, "")  /* -8 */ \
    message(zoneMalaya,           13069, "")  /* -7.5 */ \
    message(zoneIndochina,        13070, "")  /* -7 */ \
    message(zoneMyanmar,          13071, "")  /* -6.5 */ \
    message(zoneBangladesh,       13050, "")  /* -6 */ \
    message(zoneIndia,            13072, "")  /* -5.5 */ \
    message(zonePakistan,         13051, "")  /* -5 */ \
    message(zoneGulf,             13052, "")  /* -4 */ \
    message(zoneMoscow,           13073, "")  /* -3 */ \
    message(zoneEasternEurope,    13074, "")  /* -2 */ \
    message(zoneSouthAfrica,      13075, "")  /* -2 */ \
    message(zoneCentralEurope,    13076, "")  /* -1 */ \
    message(zoneGreenwich,        13077, "")  /* 0 */ \
    message(zoneAzores,           13078, "")  /* 1 */ \
    message(zoneMidAtlantic,      13053, "")  /* 2 */ \
    message(zoneBrasilia,         13079, "")  /* 3 */

// clang-format on

#define OVPHOTO_MESSAGES(message)           \
    OVPHOTO_MESSAGES_GENERAL(message)       \
    OVPHOTO_MESSAGES_NATURAL_LIGHT(message) \
    OVPHOTO_MESSAGES_WEB(message)           \
    OVPHOTO_MESSAGES_IES_CONVERT(message)   \
    OVPHOTO_MESSAGES_READ(message)          \
    OVPHOTO_MESSAGES_NIMB(message)          \
    OVPHOTO_MESSAGES_CIBSE(message)         \
    OVPHOTO_MESSAGES_TBT(message)           \
    OVPHOTO_MESSAGES_MONTHS(message)        \
    OVPHOTO_MESSAGES_ZONES(message)

namespace OvPhotometrics::messages {

#define OVPHOTO_MESSAGE_NAME(name, number, arguments) inline constexpr unsigned name = number;
OVPHOTO_MESSAGES(OVPHOTO_MESSAGE_NAME)
#undef OVPHOTO_MESSAGE_NAME

struct Message {
    unsigned id;
    const char* arguments;
};

/// All of them, for checks of the texts.
#define OVPHOTO_MESSAGE_ENTRY(name, number, arguments) Message{number, arguments},
inline constexpr Message all[] = {OVPHOTO_MESSAGES(OVPHOTO_MESSAGE_ENTRY)};
#undef OVPHOTO_MESSAGE_ENTRY

}  // namespace OvPhotometrics::messages
