// The node table's paths as one tree.
#include "nodetree.h"

#include <algorithm>

namespace kelcache {

namespace {

bool IsLevel(std::string_view component) { return component == "#" || component == "$"; }

NodeTree Build() {
   NodeTree t;
   t.positions.emplace_back();
   t.nodePosition.assign(kelplat::Nodes().size() + 1, -1);
   for (const kelplat::NodeInfo &node : kelplat::Nodes()) {
      int at = 0;
      std::string_view rest = node.path;
      while (!rest.empty()) {
         size_t slash = rest.find('/');
         std::string_view name = rest.substr(0, slash);
         rest = slash == std::string_view::npos ? std::string_view() : rest.substr(slash + 1);
         int next = IsLevel(name) ? t.LevelChild(at) : t.FixedChild(at, name);
         if (next < 0) {
            // A snapshot object holds either instances or fixed names, never both.
            const std::vector<int> &siblings = t.positions[size_t(at)].children;
            if (!siblings.empty() && (IsLevel(name) || t.LevelChild(at) >= 0)) {
               t.error = "node " + std::string(node.name) + " mixes instances and names below one object";
               return t;
            }
            Position p;
            p.name = name;
            p.levelKind = !IsLevel(name) ? -1 : name == "$" ? KEL_PARAM_STRING : KEL_PARAM_INT;
            p.parent = at;
            next = int(t.positions.size());
            t.positions.push_back(p);
            t.positions[size_t(at)].children.push_back(next);
         } else if (t.positions[size_t(next)].name != name) {
            t.error = "node " + std::string(node.name) + " has an instance level of another kind";
            return t;
         }
         at = next;
      }
      t.positions[size_t(at)].node = &node;
      t.nodePosition[node.number] = at;
   }
   // Records and data are leaves: nothing can hang below them.
   for (const Position &p : t.positions)
      if (p.node != nullptr && (p.node->recordSize > 0 || (p.node->flags & kelplat::KEL_NF_DATA)) &&
          !p.children.empty())
         t.error = "node " + std::string(p.node->name) + " holds a record and has nodes below it";
   return t;
}

}  // namespace

int NodeTree::LevelChild(int i) const {
   const Position &p = at(i);
   return p.children.size() == 1 && at(p.children[0]).levelKind >= 0 ? p.children[0] : -1;
}

int NodeTree::FixedChild(int i, std::string_view name) const {
   for (int c : at(i).children)
      if (at(c).levelKind < 0 && at(c).name == name) return c;
   return -1;
}

std::vector<int> NodeTree::Chain(int i) const {
   std::vector<int> chain;
   for (; i > 0; i = at(i).parent) chain.push_back(i);
   std::reverse(chain.begin(), chain.end());
   return chain;
}

const NodeTree &TheNodeTree() {
   static const NodeTree tree = Build();
   return tree;
}

}  // namespace kelcache
