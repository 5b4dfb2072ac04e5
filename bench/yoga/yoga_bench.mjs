// The trees of bench/arrange_bench.cpp laid out by yoga-layout, for a side-by-side comparison.
// Run scripts/bench-setup once, then: node bench/yoga/yoga_bench.mjs
// Prints one line per case: name, nanoseconds per iteration, nodes per second.
import Yoga, { Direction, FlexDirection, Wrap } from 'yoga-layout';

const kMinSeconds = 1.0;

// Leaf sizes cycle through a few values, as in the C++ benchmark.
function leafWidth(i) { return 20 + (i % 7); }
function leafHeight(i) { return 10 + (i % 5); }

function makeLeaf(i) {
  const node = Yoga.Node.create();
  node.setWidth(leafWidth(i));
  node.setHeight(leafHeight(i));
  return node;
}

// Groups of `fanout` children, rows and columns alternating by level; returns [root, leaves, nodes].
function makeTree(leafCount, fanout = 10) {
  const leaves = [];
  let level = [];
  for (let i = 0; i < leafCount; ++i) {
    const leaf = makeLeaf(i);
    leaves.push(leaf);
    level.push(leaf);
  }
  let nodes = leafCount;
  let depth = 0;
  while (level.length > 1) {
    const next = [];
    for (let i = 0; i < level.length; i += fanout) {
      const group = Yoga.Node.create();
      group.setFlexDirection(depth % 2 === 0 ? FlexDirection.Row : FlexDirection.Column);
      const children = level.slice(i, i + fanout);
      children.forEach((child, index) => group.insertChild(child, index));
      next.push(group);
      ++nodes;
    }
    level = next;
    ++depth;
  }
  return [level[0], leaves, nodes];
}

// A chain of `depth` nested groups, each with one leaf and the next group.
function makeChain(depth) {
  let inner = null;
  let nodes = 0;
  for (let level = depth - 1; level >= 0; --level) {
    const group = Yoga.Node.create();
    group.setFlexDirection(level % 2 === 0 ? FlexDirection.Row : FlexDirection.Column);
    group.insertChild(makeLeaf(level), 0);
    if (inner) group.insertChild(inner, 1);
    inner = group;
    nodes += 2;
  }
  return [inner, nodes];
}

function makeWrapping(leafCount) {
  const root = Yoga.Node.create();
  root.setFlexDirection(FlexDirection.Row);
  root.setFlexWrap(Wrap.Wrap);
  for (let i = 0; i < leafCount; ++i) root.insertChild(makeLeaf(i), i);
  return [root, leafCount + 1];
}

// Runs `body` until kMinSeconds have passed; returns nanoseconds per call.
function measure(body) {
  for (let i = 0; i < 2; ++i) body();
  let iterations = 0;
  const start = process.hrtime.bigint();
  let elapsed = 0n;
  do {
    body();
    ++iterations;
    elapsed = process.hrtime.bigint() - start;
  } while (elapsed < BigInt(kMinSeconds * 1e9));
  return Number(elapsed) / iterations;
}

function report(name, nsPerIteration, nodes) {
  const nodesPerSecond = nodes / (nsPerIteration / 1e9);
  console.log(`${name.padEnd(34)} ${nsPerIteration.toFixed(0).padStart(12)} ns ` +
              `${(nodesPerSecond / 1e6).toFixed(2).padStart(9)} M nodes/s`);
}

const kWidth = 4000;
const kHeight = 3000;

for (const leafCount of [1000, 10000, 100000]) {
  let nodes = 0;
  const buildNs = measure(() => {
    const [root, , n] = makeTree(leafCount);
    nodes = n;
    root.calculateLayout(kWidth, kHeight, Direction.LTR);
    root.freeRecursive();
  });
  report(`TreeBuildAndArrange/${leafCount}`, buildNs, nodes);

  const [root, leaves, n] = makeTree(leafCount);
  root.calculateLayout(kWidth, kHeight, Direction.LTR);
  let flip = false;
  const resizeNs = measure(() => {
    flip = !flip;
    root.calculateLayout(flip ? kWidth + 10 : kWidth, kHeight, Direction.LTR);
  });
  report(`TreeResize/${leafCount}`, resizeNs, n);

  let step = 0;
  const changeNs = measure(() => {
    ++step;
    leaves[leafCount / 2].setWidth(20 + (step % 2));
    root.calculateLayout(kWidth, kHeight, Direction.LTR);
  });
  report(`TreeLeafChanged/${leafCount}`, changeNs, n);
  root.freeRecursive();
}

// yoga-layout's time grows exponentially with the depth of alternating nested rows and columns
// (about 4x per 5 levels here), so the chain stops at depths it finishes in reasonable time;
// the C++ benchmark runs 250..2000.
for (const depth of [10, 20, 25, 30]) {
  let nodes = 0;
  const ns = measure(() => {
    const [root, n] = makeChain(depth);
    nodes = n;
    root.calculateLayout(kWidth * 10, kHeight * 10, Direction.LTR);
    root.freeRecursive();
  });
  report(`DeepChain/${depth}`, ns, nodes);
}

{
  let nodes = 0;
  const ns = measure(() => {
    const [root, n] = makeWrapping(1000);
    nodes = n;
    root.calculateLayout(800, kHeight * 10, Direction.LTR);
    root.freeRecursive();
  });
  report('Wrapping/1000', ns, nodes);
}

{
  const [root, n] = makeWrapping(1000);
  root.calculateLayout(800, kHeight * 10, Direction.LTR);
  let flip = false;
  const ns = measure(() => {
    flip = !flip;
    root.calculateLayout(flip ? 600 : 800, kHeight * 10, Direction.LTR);
  });
  report('WrappingResize/1000', ns, n);
  root.freeRecursive();
}
