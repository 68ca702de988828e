// Cost of one read and one listing from a cache file of 100,000 entries,
// through the same calls the commands make.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <cstdio>
#include <fstream>
#include <string>

#include "cachefile.h"
#include "kel/kel.h"
#include "nodetable.h"

using namespace kelplat;

namespace {

constexpr uint64_t kWorlds = 50000;  // two entries per world: 100,000 in all

const std::string &CachePath() {
   static std::string path = [] {
      CacheWriter w;
      std::vector<Key> all;
      for (uint64_t i = 1; i <= kWorlds; i++) {
         Key k{KEL_PARAM_INT, i, {}};
         all.push_back(k);
         std::string info(72, '\0');
         StoreU32(reinterpret_cast<uint8_t *>(info.data()), uint32_t(i));
         w.Add(EncodeLookup(Op::Get, KEL_NODE_world_info, std::span(&k, 1)), 0, info);
         w.Add(EncodeLookup(Op::Get, KEL_NODE_world_name, std::span(&k, 1)), 0, "world-" + std::to_string(i));
      }
      w.Add(EncodeLookup(Op::List, KEL_NODE_world, {}), 0, EncodeList(all));
      std::string p = "/tmp/orxkel-bench-" + std::to_string(getpid()) + ".cache";
      std::ofstream(p, std::ios::binary) << w.Finish(ToolSignature(), "bench");
      return p;
   }();
   return path;
}

void BM_OpenCache(benchmark::State &state) {
   for (auto _ : state) benchmark::DoNotOptimize(KEL_UseCache(CachePath().c_str(), 0));
}
BENCHMARK(BM_OpenCache)->Unit(benchmark::kMicrosecond);

void BM_ReadOneRecord(benchmark::State &state) {
   KEL_UseCache(CachePath().c_str(), 0);
   KEL_ParamList *keys = KEL_ParamListCreate(1, 1);
   uint8_t info[72];
   uint64_t i = 0;
   for (auto _ : state) {
      KEL_ParamListAddInt(keys, 1 + (i++ * 7919) % kWorlds);
      benchmark::DoNotOptimize(KEL_Get(KEL_NODE_world_info, keys, info, sizeof info));
      KEL_ParamListRemoveLastParam(keys);
   }
   KEL_ParamListDestroy(keys);
}
BENCHMARK(BM_ReadOneRecord);

void BM_ListFiftyThousandWorlds(benchmark::State &state) {
   KEL_UseCache(CachePath().c_str(), 0);
   for (auto _ : state) {
      KEL_ParamList *list = nullptr;
      benchmark::DoNotOptimize(KEL_GetInstanceListAlloc(KEL_NODE_world, nullptr, &list));
      KEL_ParamListDestroy(list);
   }
}
BENCHMARK(BM_ListFiftyThousandWorlds)->Unit(benchmark::kMicrosecond);

}  // namespace

int main(int argc, char **argv) {
   benchmark::Initialize(&argc, argv);
   benchmark::RunSpecifiedBenchmarks();
   std::remove(CachePath().c_str());
   return 0;
}
