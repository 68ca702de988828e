// ps: what its end-to-end cases cannot show.  The parent index must answer
// as the plain "first matching node" scan does, whatever the world IDs; and
// a cartel's children are read once, however many worlds the cartel has.
#include <getopt.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <random>
#include <string>
#include <vector>

#include "kel/kel.h"
#include "internal.h"
#include "keltools.h"
#include "snapshot.h"
#include "worlds/psparents.h"


namespace {

using psparents::NodeIds;

// The rule the index stands for: the first node, in order, whose cartel ID
// is not 0 and whose world ID is the node's parent cartel ID.
int32_t FirstMatchingNode(const std::vector<NodeIds> &nodes, size_t i) {
   if (nodes[i].cartelId == 0) return -1;
   for (size_t p = 0; p < nodes.size(); p++)
      if (nodes[p].cartelId != 0 && nodes[p].worldId == nodes[i].parentCartelId) return int32_t(p);
   return -1;
}

void ExpectIndexAnswersAsTheScan(const std::vector<NodeIds> &nodes) {
   std::vector<int32_t> parents(nodes.size(), 7);
   ASSERT_TRUE(psparents::FindParents(nodes.data(), uint32_t(nodes.size()), parents.data()));
   for (size_t i = 0; i < nodes.size(); i++) ASSERT_EQ(parents[i], FirstMatchingNode(nodes, i)) << "node " << i;
}

TEST(PsParents, IndexAnswersAsTheFirstMatchingNodeScan) {
   std::mt19937 random(12);
   for (int round = 0; round < 300; round++) {
      // Few distinct IDs, so that world IDs repeat, nodes point at each
      // other and at themselves, and some cartel IDs are 0.
      uint32_t ids = 1 + random() % 12;
      std::vector<NodeIds> nodes(random() % 40);
      for (NodeIds &n : nodes)
         n = {uint32_t(random() % ids), uint32_t(random() % 4 == 0 ? 0 : 1 + random() % ids),
              uint32_t(random() % (ids + 1))};
      ExpectIndexAnswersAsTheScan(nodes);
   }
}

TEST(PsParents, ExtremeIdsAndNoNodes) {
   ExpectIndexAnswersAsTheScan({});
   ExpectIndexAnswersAsTheScan({{UINT32_MAX, 1, 0}, {0, 5, UINT32_MAX}, {UINT32_MAX, 2, 0}, {0, 0, 0}, {0, 3, 0}});
}

// Runs ps with the given words against a cache built from json; returns its
// exit status and standard output, and counts the lookups it made.
int RunPs(const std::string &json, std::vector<const char *> words, std::string *out, uint64_t *lookups) {
   std::string bytes, error;
   EXPECT_TRUE(BuildCache(json, &bytes, &error)) << error;
   std::string path = ::testing::TempDir() + "ps-" + std::to_string(getpid()) + ".cache";
   std::ofstream(path, std::ios::binary) << bytes;
   EXPECT_EQ(KEL_UseCache(path.c_str(), 0), KEL_STATUS_OK);
   std::vector<char *> argv;
   argv.push_back(const_cast<char *>("ps"));
   for (const char *w : words) argv.push_back(const_cast<char *>(w));
   argv.push_back(nullptr);
   optind = 0;
   testing::internal::CaptureStdout();
   uint64_t before = kelplat::TreeLookupCount();
   int status = PsMain(int(argv.size() - 1), argv.data());
   *lookups = kelplat::TreeLookupCount() - before;
   std::fflush(stdout);
   *out = testing::internal::GetCapturedStdout();
   std::remove(path.c_str());
   return status;
}

// One cartel with many worlds and many children, every other child a zombie.
TEST(PsZombies, ACartelsChildrenAreReadOnceWhateverItsWorlds) {
   constexpr int kWorlds = 100, kChildren = 100;
   std::string worlds, children;
   for (int i = 0; i < kWorlds; i++) {
      int id = 100 + i;
      worlds += (i ? ", " : "") + std::string("\"") + std::to_string(id) + "\": {\"name\": \"w\", \"info\": " +
                "{\"worldId\": " + std::to_string(id) + ", \"cartelId\": 100, \"userspaceId\": 1, \"type\": " +
                (i == 0 ? "4" : "36") + "}}";
   }
   for (int i = 0; i < kChildren; i++)
      children += (i ? ", " : "") + std::string("\"") + std::to_string(1000 + i) + "\": {\"state\": " +
                  std::to_string(i % 2) + "}";
   std::string json = "{\"buildDate\": \"Nov 30 2026\", \"tree\": {\"world\": {" + worlds +
                      "}, \"userworld\": {\"cartel\": {\"100\": {\"cmdline\": \"x\", \"child\": {" + children +
                      "}}}}}}";
   std::string out;
   uint64_t lookups = 0;
   ASSERT_EQ(RunPs(json, {"-z", "-i"}, &out, &lookups), 0);
   // The main world keeps the 50 zombies, each once.
   EXPECT_NE(out.find("Zombie worlds:        50\n"), std::string::npos) << out;
   EXPECT_NE(out.find("1001  1001  <zombie>\n"), std::string::npos) << out;
   // Reading every child again for every world would take one lookup per
   // child and world; read once, the children cost one lookup each.
   EXPECT_LT(lookups, uint64_t(kWorlds) * kChildren / 4);
}

}  // namespace
