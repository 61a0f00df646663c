/*
 * Rows of the layout's tables that say several things at once.
 *
 * OBJECT(type): a handle and its table. TABLE(type, size, slots...): a version, and slots in this order behind it.
 * SLOTS(type, first, slots...): slots from that one on, counted in pointers. FROM(number, names...): names that count.
 * AT_START(type, size, members...): members of that size at offset 0. ARRAYS(types...): the code of arrays of each
 * type.
 */
#pragma once

/* __VA_OPT__ works, but is younger than the standards that the headers are checked with. */
#pragma GCC system_header

#define OBJECT(type) STRUCT(type, 16, 8) FIELD(type, hdl, 0, 8) FIELD(type, ft, 8, 8)
#define TABLE(type, size, ...) STRUCT(type, size, 8) FIELD(type, ftVersion, 0, 4) SLOTS(type, 1, __VA_ARGS__)
#define SLOTS(type, first, ...) EACH_OF(SLOT, type, first, __VA_ARGS__)
#define SLOT(type, number, member) FIELD(type, member, 8 * (number), 8)
#define AT_START(type, size, ...) EACH_OF(AT_START_##size, type, 0, __VA_ARGS__)
#define AT_START_8(type, number, member) FIELD(type, member, 0, 8)
#define AT_START_4(type, number, member) FIELD(type, member, 0, 4)
#define AT_START_2(type, number, member) FIELD(type, member, 0, 2)
#define AT_START_1(type, number, member) FIELD(type, member, 0, 1)
#define ARRAYS(...) EACH_OF(ARRAY_CODE, , 0, __VA_ARGS__)
#define ARRAY_CODE(nothing, number, type) VALUE(CMPI_##type##A, (8192 | CMPI_##type))
#define FROM(first, ...) EACH_OF(COUNTED, , first, __VA_ARGS__)
#define COUNTED(nothing, number, name) VALUE(name, number)

/* ROW(with, number, name) for each of up to 256 names; the numbers count from `first`. */
#define EACH_OF(ROW, with, first, ...) EACH_4(EACH_STEP(ROW, with, first, __VA_ARGS__, ))
#define EACH_STEP(ROW, with, number, name, ...)                                                                        \
    ROW(with, number, name) __VA_OPT__(EACH_AGAIN EACH_PARENTHESES(ROW, with, number + 1, __VA_ARGS__))
#define EACH_AGAIN() EACH_STEP
#define EACH_PARENTHESES ()
#define EACH_4(...) EACH_3(EACH_3(EACH_3(EACH_3(__VA_ARGS__))))
#define EACH_3(...) EACH_2(EACH_2(EACH_2(EACH_2(__VA_ARGS__))))
#define EACH_2(...) EACH_1(EACH_1(EACH_1(EACH_1(__VA_ARGS__))))
#define EACH_1(...) EACH_0(EACH_0(EACH_0(EACH_0(__VA_ARGS__))))
#define EACH_0(...) __VA_ARGS__
