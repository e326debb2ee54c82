"""Writes and proves the lists of reserved words in data/keywords.

  reserved_words.py write FOLDER    writes the lists that come from headers
  reserved_words.py check FOLDER    proves every list, prints each fault

A list from headers holds the functions, types, constants, variables and macros
of the headers of an edition. The script tries every token of the preprocessed
headers as `int TOKEN = 1;` behind the headers; a token that the compiler refuses
is taken. Every token stands on a line of its own, so a single run of the compiler
tries all tokens.

check demands of every word in every list one of:
  - a compiler of that mode refuses `int WORD = 1;`
  - a header of that mode declares or defines the word
  - the word stands in ACCEPTED or STANDARD below: the installed compilers and
    headers are older than the word, or the word is reserved in places only
and that every word taken by the headers stands in the list.
"""

import pathlib
import re
import subprocess
import sys

C90 = "assert ctype errno float limits locale math setjmp signal stdarg stddef stdio stdlib string time"
C99 = C90 + " complex fenv inttypes iso646 stdbool stdint tgmath wchar wctype"
C11 = C99 + " stdalign stdatomic stdnoreturn threads uchar"
POSIX = """aio arpa/inet assert complex cpio ctype dirent dlfcn errno fcntl fenv
  float fmtmsg fnmatch ftw glob grp iconv inttypes iso646 langinfo libgen limits
  locale math monetary mqueue ndbm net/if netdb netinet/in netinet/tcp nl_types
  poll pthread pwd regex sched search semaphore setjmp signal spawn stdarg
  stdbool stddef stdint stdio stdlib string strings stropts sys/ipc sys/mman
  sys/msg sys/resource sys/select sys/sem sys/shm sys/socket sys/stat
  sys/statvfs sys/time sys/times sys/types sys/uio sys/un sys/utsname sys/wait
  syslog tar termios tgmath time trace ulimit unistd utime utmpx wchar wctype
  wordexp"""

# Profile: options of the compiler, headers. A header that is not installed is
# left out.
MODES = {
    "std_c90": (["-std=c90"], C90.split()),
    "std_c99": (["-std=c99"], C99.split()),
    "std_c11": (["-std=c11"], C11.split()),
    "std_c23": (["-std=c2x"], (C11 + " stdbit stdckdint").split()),
    "posix": (["-std=c99", "-D_XOPEN_SOURCE=700"], POSIX.split()),
}
STRICT = ["-pedantic-errors", "-x", "c"]
# Profile: pairs of a compiler and headers. One of the pairs has to refuse a
# word of the profile. The installed gcc is older than C23: its headers define
# most keywords that C23 has beyond C11.
LANGUAGES = {
    "c90": [(["gcc", "-std=c90", *STRICT], "")],
    "c99": [(["gcc", "-std=c99", *STRICT], "")],
    "c11": [(["gcc", "-std=c11", *STRICT], "")],
    "c23": [(["gcc", "-std=c2x", *STRICT], "stdbool stdalign assert threads"),
            (["gcc", "-std=gnu2x", "-x", "c"], "")],
    "cpp20": [(["g++", "-std=c++20", "-pedantic-errors", "-x", "c++"], "")],
    "gnu_c": [(["gcc", "-std=gnu2x", "-x", "c"], ""),
              (["gcc", "-m32", "-std=gnu2x", "-x", "c"], "")],
}
TITLES = {
    "std_c90": ("Functions and types of the standard library of C90.",
                "ISO/IEC 9899:1990, clause 7."),
    "std_c99": ("Functions and types of the standard library of C99.",
                "ISO/IEC 9899:1999, clause 7."),
    "std_c11": ("Functions, types and constants of the standard library of C11 and C17.",
                "ISO/IEC 9899:2011, clause 7."),
    "std_c23": ("Functions, types and constants of the standard library of C23.",
                "ISO/IEC 9899:2024, clause 7."),
    "posix": ("Functions, types, constants and macros of POSIX, with those of C99.",
              "IEEE Std 1003.1-2017, Base Definitions, clause 13."),
    "std_macros": ("Macros of the C standard library, C90 to C23.",
                   "ISO/IEC 9899:1990 to 2024, clause 7."),
}


def suffixed(names, suffixes):
    return {name + suffix for name in names.split() for suffix in suffixes.split(",")}


MATH = """acos asin atan atan2 cos sin tan acospi asinpi atanpi atan2pi cospi
  sinpi tanpi acosh asinh atanh cosh sinh tanh exp exp10 exp10m1 exp2 exp2m1
  expm1 frexp ilogb ldexp llogb log log10 log10p1 log1p log2 log2p1 logb logp1
  modf scalbn scalbln cbrt compoundn fabs hypot pow pown powr rootn rsqrt sqrt
  erf erfc lgamma tgamma ceil floor nearbyint rint lrint llrint round lround
  llround roundeven trunc fromfp ufromfp fromfpx ufromfpx fmod remainder
  copysign nan nextafter nextup nextdown canonicalize fdim fmax fmin fmaximum
  fminimum fmaximum_mag fminimum_mag fmaximum_num fminimum_num
  fmaximum_mag_num fminimum_mag_num fma totalorder totalordermag getpayload
  setpayload setpayloadsig"""
DECIMAL_MATH = MATH + " quantize samequantum quantum llquantexp"
BITS = """leading_zeros leading_ones trailing_zeros trailing_ones
  first_leading_zero first_leading_one first_trailing_zero first_trailing_one
  count_zeros count_ones has_single_bit bit_width bit_floor bit_ceil"""

# What the edition has and no header needs to show.
STANDARD = {
    "std_c90": set(), "std_c99": set(), "std_c11": set(),
    "posix": set("_exit _longjmp _setjmp _tolower _toupper environ".split()),
    "std_c23": suffixed(MATH, ",f,l") | suffixed("remquo nexttoward", ",f,l")
    | suffixed(DECIMAL_MATH, "d32,d64,d128")
    | suffixed("nexttoward", "d32,d64,d128")
    | suffixed("encodedec decodedec encodebin decodebin", "d32,d64,d128")
    | suffixed("fadd fsub fmul fdiv ffma fsqrt", ",l")
    | suffixed("dadd dsub dmul ddiv dfma dsqrt", "l")
    | suffixed("d32add d32sub d32mul d32div d32fma d32sqrt", "d64,d128")
    | suffixed("d64add d64sub d64mul d64div d64fma d64sqrt", "d128")
    | suffixed("strfrom strto wcsto", "d32,d64,d128")
    | {"stdc_" + name for name in suffixed(BITS, ",_uc,_us,_ui,_ul,_ull")}
    | set("""atomic_char8_t c8rtomb call_once char8_t ckd_add ckd_mul ckd_sub
             fe_dec_getround fe_dec_setround femode_t free_aligned_sized
             free_sized gmtime_r localtime_r mbrtoc8 memalignment memccpy
             memset_explicit nullptr_t once_flag strdup strndup timegm
             timespec_getres""".split()),
    "std_macros": set("""ATOMIC_CHAR8_T_LOCK_FREE DEC_EVAL_METHOD DEC_INFINITY
        DEC_NAN FE_DEC_DOWNWARD FE_DEC_TONEAREST FE_DEC_TONEARESTFROMZERO
        FE_DEC_TOWARDZERO FE_DEC_UPWARD FE_DFL_MODE FE_SNANS_ALWAYS_SIGNAL
        FE_TONEARESTFROMZERO FP_FAST_FMA FP_FAST_FMAF FP_FAST_FMAL HUGE_VAL_D128
        HUGE_VAL_D32 HUGE_VAL_D64 NDEBUG TIME_ACTIVE TIME_MONOTONIC
        TIME_THREAD_ACTIVE _Complex_I _IOFBF _IOLBF _IONBF _Imaginary_I
        __DATE__ __FILE__ __LINE__ __STDC_HOSTED__ __STDC_IEC_559_COMPLEX__
        __STDC_IEC_559__ __STDC_ISO_10646__ __STDC_UTF_16__ __STDC_UTF_32__
        __STDC_VERSION__ __STDC__ __TIME__ __alignas_is_defined
        __alignof_is_defined __bool_true_false_are_defined imaginary setjmp
        stderr stdin stdout unreachable""".split())
    | {"FP_FAST_" + name.upper() for name in
       suffixed("fadd fsub fmul fdiv ffma fsqrt", ",l")
       | suffixed("dadd dsub dmul ddiv dfma dsqrt", "l")
       | suffixed("d32add d32sub d32mul d32div d32fma d32sqrt", "d64,d128")
       | suffixed("d64add d64sub d64mul d64div d64fma d64sqrt", "d128")}
    | {f"{kind}{letter}{size}" for kind, letters in (("PRI", "bB"), ("SCN", "b"))
       for letter in letters
       for size in suffixed("LEAST FAST", "8,16,32,64")
       | set("8 16 32 64 MAX PTR".split())},
}

# Words that every compiler here accepts, with the reason.
ACCEPTED = {
    # Newer than gcc 12.
    "c23": {"_BitInt", "constexpr", "nullptr", "typeof_unqual"},
    "cpp20": {"final", "import", "module", "override"},  # mean something in places
}
# Lists without a header or a compiler here.
UNPROVEN = {"osek"}


def header_lines(headers):
    found = []
    for header in headers:
        line = f"#include <{header}.h>\n"
        run = subprocess.run(["gcc", "-E", "-x", "c", "-o", "/dev/null", "-"],
                             input=line, text=True, capture_output=True)
        if run.returncode == 0:
            found.append(line)
    return "".join(found)


def refused(compiler, prologue, words):
    """The words that the compiler refuses as `int WORD = 1;` behind prologue.

    A line with a fresh name stands behind each word: an error there would be
    the consequence of the line before, and is a fault of this script.
    """
    words = sorted(words)
    first = prologue.count("\n") + 1
    lines = []
    for number, word in enumerate(words):
        lines.append(f"int {word} = 1;\nint hx_control_{number} = 1;\n")
    if "g++" in compiler[0]:
        lines = [f"namespace hx_{n} {{ {line.splitlines()[0]} }}\n{line.splitlines()[1]}\n"
                 for n, line in enumerate(lines)]
    run = subprocess.run(
        compiler + ["-w", "-fsyntax-only", "-fmax-errors=0",
                    "-fno-diagnostics-show-caret", "-"],
        input=prologue + "".join(lines), text=True, capture_output=True)
    bad = {int(line) for line in
           re.findall(r"^<stdin>:(\d+):(?:\d+:)? error", run.stderr, re.M)}
    for line in sorted(bad):
        if line < first or (line - first) % 2 == 1:
            sys.exit(f"{' '.join(compiler)}: unexpected error in line {line}\n"
                     + "\n".join(text for text in run.stderr.splitlines()
                                 if f":{line}:" in text))
    return {word for number, word in enumerate(words)
            if first + 2 * number in bad}


def preprocessed(options, text, *more):
    return subprocess.run(["gcc", *options, *more, "-E", "-P", "-x", "c", "-"],
                          input=text, text=True, capture_output=True,
                          check=True).stdout


def macros_of(options, prologue):
    text = preprocessed(options, prologue, "-dM")
    plain = preprocessed(options, "", "-dM")
    names = lambda t: set(re.findall(r"^#define (\w+)", t, re.M))
    return names(text) - names(plain)


def is_ours(word):
    """Whether a word is worth a row: names of the implementation are not."""
    return not word.startswith("_")


def declared(profile):
    """What the headers of a profile declare and define, macros apart."""
    options, headers = MODES[profile]
    prologue = header_lines(headers)
    macros = macros_of(options, prologue)
    tokens = set(re.findall(r"[A-Za-z_]\w*", preprocessed(options, prologue)))
    tokens = {word for word in tokens | macros if is_ours(word)}
    gcc = ["gcc", *options, "-x", "c"]
    undone = "".join(f"#undef {word}\n" for word in sorted(macros)
                     if is_ours(word))
    words = refused(gcc, prologue + undone, tokens)
    words -= refused(gcc, "", tokens)
    return words, {word for word in macros if is_ours(word)}


def built_lists():
    """Profile -> words, for the lists that come from headers."""
    lists = {}
    macros = set()
    functions = set()
    for profile in MODES:
        words, defined = declared(profile)
        lists[profile] = words | STANDARD[profile]
        if profile == "posix":
            lists[profile] |= defined
            continue
        # Type-generic macros are functions of the same name.
        options, headers = MODES[profile]
        macros |= {word for word in macros_of(options, header_lines(
            [header for header in headers if header != "tgmath"]))
            if is_ours(word)}
        functions |= words
    # A constant may be an enumerator as well; a function may be a macro as well.
    lists["std_macros"] = {word for word in macros if word[0].isupper()
                           or word not in functions} | STANDARD["std_macros"]
    return lists


def read_list(path):
    return [line for line in path.read_text().splitlines()
            if line and not line.startswith("#")]


def write(folder):
    for profile, words in built_lists().items():
        title, source = TITLES[profile]
        (folder / f"{profile}.txt").write_text(
            f"# {title}\n# Source: {source}\n"
            f"# Written by script/reserved_words.py.\n"
            + "".join(word + "\n" for word in sorted(words)))


def check(folder):
    faults = []
    lists = {path.stem: read_list(path) for path in sorted(folder.glob("*.txt"))}
    for profile, words in lists.items():
        if words != sorted(set(words)):
            faults.append(f"{profile}: not sorted, or a word twice")
    for profile, trials in LANGUAGES.items():
        accepted = set(lists[profile])
        for compiler, headers in trials:
            accepted -= refused(compiler, header_lines(headers.split()), accepted)
        expected = ACCEPTED.get(profile, set())
        for word in sorted(accepted - expected):
            faults.append(f"{profile}: {word}: the compiler accepts it")
        for word in sorted(expected - accepted):
            faults.append(f"{profile}: {word}: the compiler refuses it now")
    fresh = built_lists()
    for profile, words in fresh.items():
        for word in sorted(words - set(lists[profile])):
            faults.append(f"{profile}: {word}: of the headers, not in the list")
        for word in sorted(set(lists[profile]) - words):
            faults.append(f"{profile}: {word}: in the list, not of the headers")
    proven = set(LANGUAGES) | set(fresh) | UNPROVEN | {"main"}
    for profile in sorted(set(lists) ^ proven):
        faults.append(f"{profile}: no proof for this list, or no such list")
    accepted = refused(["gcc", "-std=c90", "-x", "c"],
                       "int main(void) { return 0; }\n", lists["main"])
    if accepted != set(lists["main"]):
        faults.append("main: the compiler accepts a second one")
    if faults:
        sys.exit("\n".join(faults))
    print(sum(len(words) for words in lists.values()), "words in",
          len(lists), "lists hold")


if __name__ == "__main__":
    if len(sys.argv) != 3 or sys.argv[1] not in ("write", "check"):
        sys.exit(__doc__)
    {"write": write, "check": check}[sys.argv[1]](pathlib.Path(sys.argv[2]))
