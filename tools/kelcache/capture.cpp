// kelcache capture: walks the Linux tree source through the node table, as
// a command would, and saves what it answers with the writer that
// `kelcache build` uses.
#include "capture.h"

#include <cstdio>
#include <string_view>
#include <vector>

#include "cachefile.h"
#include "linuxtree.h"
#include "nodetree.h"
#include "snapshot.h"

namespace {

using kelplat::Key;
using kelplat::Op;

class Walker {
public:
   Walker(const kelplat::LinuxTree &source, kelplat::CacheWriter &writer) : source_(source), writer_(writer) {}

   // Reads the record at pos, then lists its instance level or walks its
   // fixed children.
   void Walk(int pos) {
      const kelcache::Position &at = tree_.at(pos);
      uint32_t status = 0;
      if (at.node != nullptr && at.node->recordSize > 0) {
         std::string record;
         if (source_.Read(at.node->number, keys_, &status, &record))
            writer_.Add(kelplat::EncodeLookup(Op::Get, at.node->number, keys_), status, std::move(record));
      }
      int level = tree_.LevelChild(pos);
      if (level < 0) {
         for (int child : at.children) Walk(child);
         return;
      }
      std::vector<Key> instances;
      if (!source_.Instances(PathOf(level), keys_, &status, &instances)) return;
      const kelplat::NodeInfo *lister = tree_.at(level).node;
      if (lister != nullptr)
         writer_.Add(kelplat::EncodeLookup(Op::List, lister->number, keys_), status, kelplat::EncodeList(instances));
      for (Key &key : instances) {
         keys_.push_back(std::move(key));
         Walk(level);
         keys_.pop_back();
      }
   }

private:
   std::string PathOf(int pos) const {
      std::string path;
      for (int p : tree_.Chain(pos)) path += (path.empty() ? "" : "/") + std::string(tree_.at(p).name);
      return path;
   }

   const kelcache::NodeTree &tree_ = kelcache::TheNodeTree();
   const kelplat::LinuxTree &source_;
   kelplat::CacheWriter &writer_;
   std::vector<Key> keys_;
};

int Usage(std::string_view problem) {
   std::fprintf(stderr, "kelcache: %.*s\nusage: kelcache capture [-o FILE] [--json]\n", int(problem.size()),
                problem.data());
   return 2;
}

}  // namespace

int RunCapture(std::span<char *const> args, WriteFileFn write) {
   std::string output;
   bool json = false, haveOutput = false;
   for (size_t i = 0; i < args.size(); i++) {
      std::string_view word = args[i];
      if (word == "-o" && i + 1 < args.size()) {
         output = args[++i];
         haveOutput = true;
      } else if (word == "--json") {
         json = true;
      } else {
         return Usage("unexpected argument '" + std::string(word) + "'");
      }
   }
   if (!haveOutput && !json) return Usage("capture needs -o FILE or --json");

   kelplat::LinuxTree source;
   source.Capture();
   kelplat::CacheWriter writer;
   Walker(source, writer).Walk(0);
   std::string bytes = writer.Finish(kelplat::ToolSignature(), source.BuildDate());
   for (const std::string &line : source.Skipped()) std::fprintf(stderr, "kelcache: skipped %s\n", line.c_str());

   std::string problem;
   if (json) {
      std::string text;
      if (!DumpCache(bytes, &text, &problem)) {
         std::fprintf(stderr, "kelcache: %s\n", problem.c_str());
         return 1;
      }
      bytes = std::move(text);
   }
   if (!haveOutput) {
      if (std::fwrite(bytes.data(), 1, bytes.size(), stdout) != bytes.size() || std::fflush(stdout) != 0) {
         std::fprintf(stderr, "kelcache: write error\n");
         return 1;
      }
      return 0;
   }
   if (!write(output, bytes, &problem)) {
      std::fprintf(stderr, "kelcache: %s: %s\n", output.c_str(), problem.c_str());
      return 1;
   }
   return 0;
}
