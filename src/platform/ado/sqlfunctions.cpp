#include "platform/ado/sqlfunctions.h"

#include "platform/text/collation.h"
#include "platform/text/likepattern.h"
#include "platform/text/numeric.h"

#ifdef SONGCASE_SQLITE_EXTENSION
#include <sqlite3ext.h>
SQLITE_EXTENSION_INIT1
#else
#include <sqlite3.h>
#endif

#include <string_view>

namespace ADODB
{

namespace
{

std::string_view textOf(sqlite3_value *value)
{
    const auto *bytes = reinterpret_cast<const char *>(sqlite3_value_text(value));
    return {bytes ? bytes : "", std::size_t(sqlite3_value_bytes(value))};
}

bool anyNull(int count, sqlite3_value **values)
{
    for (int i = 0; i < count; ++i) {
        if (sqlite3_value_type(values[i]) == SQLITE_NULL)
            return true;
    }
    return false;
}

int collate(void *, int sizeA, const void *a, int sizeB, const void *b)
{
    return text::Collation::root().compare({static_cast<const char *>(a), std::size_t(sizeA)},
                                           {static_cast<const char *>(b), std::size_t(sizeB)});
}

// like(pattern, text), the order in which SQLite hands them over. SQLite keeps the compiled pattern
// as long as the statement runs with the same one.
void like(sqlite3_context *context, int count, sqlite3_value **values)
{
    if (anyNull(count, values))
        return;
    auto *pattern = static_cast<text::LikePattern *>(sqlite3_get_auxdata(context, 0));
    if (pattern) {
        sqlite3_result_int(context, pattern->matches(textOf(values[1])));
        return;
    }
    pattern = new text::LikePattern(textOf(values[0]));
    sqlite3_result_int(context, pattern->matches(textOf(values[1])));
    sqlite3_set_auxdata(context, 0, pattern,
                        [](void *p) { delete static_cast<text::LikePattern *>(p); });
}

void isNumeric(sqlite3_context *context, int, sqlite3_value **values)
{
    const auto s = textOf(values[0]);
    sqlite3_result_int(context, text::isNumeric(s.data(), s.size()));
}

void left(sqlite3_context *context, int count, sqlite3_value **values)
{
    if (anyNull(count, values))
        return;
    const auto s = textOf(values[0]);
    sqlite3_int64 characters = sqlite3_value_int64(values[1]);
    std::size_t end = 0;
    for (; end < s.size() && characters > 0; --characters) {
        do
            ++end;
        while (end < s.size() && (s[end] & 0xC0) == 0x80);
    }
    sqlite3_result_text(context, s.data(), int(end), SQLITE_TRANSIENT);
}

} // namespace

int registerFunctions(sqlite3 *db)
{
    constexpr int flags = SQLITE_UTF8 | SQLITE_DETERMINISTIC | SQLITE_INNOCUOUS;
    int code = sqlite3_create_collation(db, collationName, SQLITE_UTF8, nullptr, collate);
    if (code == SQLITE_OK)
        code = sqlite3_create_function(db, "like", 2, flags, nullptr, like, nullptr, nullptr);
    if (code == SQLITE_OK)
        code = sqlite3_create_function(db, "isnumeric", 1, flags, nullptr, isNumeric, nullptr,
                                       nullptr);
    if (code == SQLITE_OK)
        code = sqlite3_create_function(db, "left", 2, flags, nullptr, left, nullptr, nullptr);
    return code;
}

} // namespace ADODB

#ifdef SONGCASE_SQLITE_EXTENSION
extern "C" int sqlite3_songcase_init(sqlite3 *db, char **, const sqlite3_api_routines *api)
{
    SQLITE_EXTENSION_INIT2(api)
    return ADODB::registerFunctions(db);
}
#endif
