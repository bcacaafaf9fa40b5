# Runs one fuzz target for a bounded time over its seed corpus:
#   cmake -D FUZZER=<exe> -D SEEDS=<seed dir> -D WORK=<scratch dir> -D RUNS=<n> -D SECONDS=<s> -P RunFuzzer.cmake
# New inputs go to a scratch corpus that is emptied first, so every run starts from the seeds alone
# (with -seed=1 the same inputs are tried, as far as the time cap allows) and the seeds in the
# source tree are never written. A failing input is kept in WORK/artifacts.
foreach(var FUZZER SEEDS WORK RUNS SECONDS)
  if(NOT DEFINED ${var})
    message(FATAL_ERROR "RunFuzzer.cmake needs -D ${var}=...")
  endif()
endforeach()
file(REMOVE_RECURSE "${WORK}/corpus")
file(MAKE_DIRECTORY "${WORK}/corpus" "${WORK}/artifacts")
execute_process(
  COMMAND "${FUZZER}" -seed=1 -runs=${RUNS} -max_total_time=${SECONDS} -timeout=30 -rss_limit_mb=2048
          -max_len=4096 -print_final_stats=1 -artifact_prefix=${WORK}/artifacts/
          "${WORK}/corpus" "${SEEDS}"
  RESULT_VARIABLE result)
if(NOT result EQUAL 0)
  message(FATAL_ERROR "${FUZZER} failed (${result}); the input that failed is in ${WORK}/artifacts")
endif()
