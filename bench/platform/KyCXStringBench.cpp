// Texts beside std::u16string, and beside QString where Qt is installed. One
// item is a text of the size given: 25 units are a name, 1,000 a long text.

#include "platform/strings/KyCXString.h"

#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#ifdef HX_HAVE_QT
#include <QString>
#endif

namespace {

constexpr int kTexts = 64;  // enough that no branch learns one text by heart

// Text i of a series; the texts have the same size and different ends.
std::string sample(int size, int i) {
  static const char kWords[] = "subsystem_controller_gain_";
  std::string text;
  while (static_cast<int>(text.size()) < size) text += kWords;
  text.resize(static_cast<std::size_t>(size));
  text[text.size() - 1] = static_cast<char>('a' + i % 26);
  text[text.size() - 2] = static_cast<char>('A' + i / 26);
  return text;
}

template <class Text>
Text make(const std::string& text);
template <>
KyCXString make(const std::string& text) {
  return KyCXString(text.c_str());
}
template <>
std::u16string make(const std::string& text) {
  return std::u16string(text.begin(), text.end());
}

// The differing names of the two libraries.
KyCXString subOf(const KyCXString& text, int from, int to) {
  return text.sub(from, to);
}
std::u16string subOf(const std::u16string& text, int from, int to) {
  return text.substr(static_cast<std::size_t>(from),
                     static_cast<std::size_t>(to - from + 1));
}
int compareOf(const KyCXString& a, const KyCXString& b) {
  return a.compareWith(b);
}
int findIn(const KyCXString& a, const KyCXString& b) { return a.find(b, 0); }
KyCXString from8Bit(const KyCXString&, const char* text) {
  return KyCXString(text);
}
const char* to8Bit(const KyCXString& text) { return text.cstring(); }

#ifdef HX_HAVE_QT
template <>
QString make(const std::string& text) {
  return QString::fromLatin1(text.c_str());
}
int compareOf(const QString& a, const QString& b) { return a.compare(b); }
int findIn(const QString& a, const QString& b) {
  return static_cast<int>(a.indexOf(b));
}
QString from8Bit(const QString&, const char* text) {
  return QString::fromLatin1(text);
}
QByteArray to8Bit(const QString& text) { return text.toLatin1(); }
#endif

// Calls work(text, other, 8-bit text) for all texts; \p other is an equal
// text in another object.
template <class Text, class Work>
void forEachText(benchmark::State& state, Work work) {
  const int size = static_cast<int>(state.range(0));
  std::vector<std::string> narrow;
  std::vector<Text> texts;
  std::vector<Text> others;
  for (int i = 0; i < kTexts; ++i) {
    narrow.push_back(sample(size, i));
    texts.push_back(make<Text>(narrow.back()));
    others.push_back(make<Text>(sample(size, i)));
  }
  for (auto _ : state)
    for (std::size_t i = 0; i < kTexts; ++i) {
      auto result = work(texts[i], others[i], narrow[i].c_str());
      benchmark::DoNotOptimize(result);
    }
  state.SetItemsProcessed(state.iterations() * kTexts);
}

template <class Text>
void BM_Copy(benchmark::State& state) {
  forEachText<Text>(state, [](const Text& text, const Text&, const char*) {
    return Text(text);
  });
}

// All but the first and the last unit.
template <class Text>
void BM_Sub(benchmark::State& state) {
  const int size = static_cast<int>(state.range(0));
  forEachText<Text>(state, [size](const Text& text, const Text&, const char*) {
    return subOf(text, 1, size - 2);
  });
}

// A new text of the two texts.
template <class Text>
void BM_Append(benchmark::State& state) {
  forEachText<Text>(state,
                    [](const Text& text, const Text& other, const char*) {
                      Text sum;
                      sum += text;
                      sum += other;
                      return sum;
                    });
}

template <class Text>
void BM_Compare(benchmark::State& state) {
  forEachText<Text>(state, [](const Text& text, const Text& other,
                              const char*) { return compareOf(text, other); });
}

// Looks for the end of the text; the beginning of the end occurs throughout.
template <class Text>
void BM_Find(benchmark::State& state) {
  const int size = static_cast<int>(state.range(0));
  const Text end =
      make<Text>(sample(size, 5).substr(sample(size, 5).size() - 6));
  forEachText<Text>(state, [&end](const Text& text, const Text&, const char*) {
    return findIn(text, end);
  });
}

template <class Text>
void BM_From8Bit(benchmark::State& state) {
  forEachText<Text>(state,
                    [](const Text& text, const Text&, const char* narrow) {
                      return from8Bit(text, narrow);
                    });
}

template <class Text>
void BM_To8Bit(benchmark::State& state) {
  forEachText<Text>(state, [](const Text& text, const Text&, const char*) {
    return to8Bit(text);
  });
}

BENCHMARK(BM_Copy<KyCXString>)->Arg(25);
BENCHMARK(BM_Copy<std::u16string>)->Arg(25);
BENCHMARK(BM_Sub<KyCXString>)->Arg(25);
BENCHMARK(BM_Sub<std::u16string>)->Arg(25);
BENCHMARK(BM_Append<KyCXString>)->Arg(25);
BENCHMARK(BM_Append<std::u16string>)->Arg(25);
BENCHMARK(BM_Compare<KyCXString>)->Arg(25)->Arg(1000);
BENCHMARK(BM_Find<KyCXString>)->Arg(25)->Arg(1000);
BENCHMARK(BM_From8Bit<KyCXString>)->Arg(25)->Arg(1000);
BENCHMARK(BM_To8Bit<KyCXString>)->Arg(25)->Arg(1000);
#ifdef HX_HAVE_QT
BENCHMARK(BM_Compare<QString>)->Arg(25)->Arg(1000);
BENCHMARK(BM_Find<QString>)->Arg(25)->Arg(1000);
BENCHMARK(BM_From8Bit<QString>)->Arg(25)->Arg(1000);
BENCHMARK(BM_To8Bit<QString>)->Arg(25)->Arg(1000);
#else
void BM_QString(benchmark::State& state) {
  state.SkipWithError("peer not installed: qtbase5-dev");
}
BENCHMARK(BM_QString)->Name("BM_Compare<QString>")->Arg(25)->Arg(1000);
BENCHMARK(BM_QString)->Name("BM_Find<QString>")->Arg(25)->Arg(1000);
BENCHMARK(BM_QString)->Name("BM_From8Bit<QString>")->Arg(25)->Arg(1000);
BENCHMARK(BM_QString)->Name("BM_To8Bit<QString>")->Arg(25)->Arg(1000);
#endif

}  // namespace
