#ifndef OVO_BENCH_REWRITER_THROUGHPUT_PART_H
#define OVO_BENCH_REWRITER_THROUGHPUT_PART_H

// Reads every file of corpus_dir as a vertex shader's source and registers rewriter/corpus:
// each iteration rewrites all of them as the shader injection does (a rewriter per shader,
// its declaration and statement set, one place, the length with the terminating NUL), with
// the rewriter's trace sent to /dev/null, and reports the source bytes per second. False
// after printing why.
bool RegisterRewriterBenchmark(const char* corpus_dir);

#endif
