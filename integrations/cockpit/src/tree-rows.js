// The tree as a list of rows; see views/tree.js.

/** Returns the nodes of 'mihost tree' with their children and, for the search, their text in lower case. */
export function buildTree(rows) {
    const nodes = new Map();
    for (const row of rows)
        nodes.set(row.id, { ...row, children: [], text: `${row.address} ${row.headline} ${row.id}`.toLowerCase() });
    const roots = [];
    for (const node of nodes.values())
        (nodes.get(node.parent)?.children ?? roots).push(node);
    return { nodes, roots };
}

/** Returns a node's name: what follows the kind in its address. */
export function nameOf(node) {
    const colon = node.address.indexOf(":");
    return colon < 0 ? node.address : node.address.slice(colon + 1);
}

/** Returns the kind of the node with this address. */
export function kindOf(address) {
    const colon = address.indexOf(":");
    const kind = colon < 0 ? address : address.slice(0, colon);
    return kind === "log" && colon >= 0 ? "log-entry" : kind;
}

/**
 * Returns the rows to show: with a search or a kind, the nodes that match and their parents; otherwise
 * the children of expanded nodes.
 */
export function visibleRows(roots, { expanded, search = "", kind = "" }) {
    const wanted = search.trim().toLowerCase();
    const filtering = wanted !== "" || kind !== "";
    const matches = node => node.text.includes(wanted) && (kind === "" || node.kind === kind);
    const result = [];

    // Children come first, to know whether their parent has a match below it.
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

/** Returns the kinds of nodes, in the order of the tree. */
export function kindsOf(nodes) {
    return [...new Set([...nodes.values()].map(node => node.kind))];
}
