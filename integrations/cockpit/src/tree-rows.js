// The tree as the rows that are in sight; see views/tree.js.

/** The nodes of 'mihost tree' with their children and, for the search, their text in lower case. */
export function buildTree(rows) {
    const nodes = new Map();
    for (const row of rows)
        nodes.set(row.id, { ...row, children: [], text: `${row.address} ${row.headline} ${row.id}`.toLowerCase() });
    const roots = [];
    for (const node of nodes.values())
        (nodes.get(node.parent)?.children ?? roots).push(node);
    return { nodes, roots };
}

/** A node's own name: what follows the kind in its address. */
export function nameOf(node) {
    const colon = node.address.indexOf(":");
    return colon < 0 ? node.address : node.address.slice(colon + 1);
}

/** The kind of the node with this address. */
export function kindOf(address) {
    const colon = address.indexOf(":");
    const kind = colon < 0 ? address : address.slice(0, colon);
    return kind === "log" && colon >= 0 ? "log-entry" : kind;
}

/**
 * The rows to show. With a search or a kind those are the nodes that match, and the way to them;
 * else what the expanded nodes hold.
 */
export function visibleRows(roots, { expanded, search = "", kind = "" }) {
    const wanted = search.trim().toLowerCase();
    const filtering = wanted !== "" || kind !== "";
    const matches = node => node.text.includes(wanted) && (kind === "" || node.kind === kind);
    const result = [];

    // Children come first, to know whether their parent leads to a match.
    function kept(siblings) {
        return siblings.map(node => ({ node, below: kept(node.children) }))
            .filter(({ node, below }) => below.length > 0 || matches(node));
    }
    function all(siblings) {
        return siblings.map(node => ({ node, below: expanded.has(node.address) ? all(node.children) : [] }));
    }
    function flatten(branches, level) {
        branches.forEach(({ node, below }, i) => {
            const open = filtering ? below.length > 0 : expanded.has(node.address);
            const parent = filtering ? below.length > 0 : node.children.length > 0;
            result.push({ node, level, position: i + 1, siblings: branches.length, open: parent ? open : null });
            flatten(below, level + 1);
        });
    }
    flatten(filtering ? kept(roots) : all(roots), 1);
    return result;
}

/** The kinds of nodes that there are, in the order of the tree. */
export function kindsOf(nodes) {
    return [...new Set([...nodes.values()].map(node => node.kind))];
}
