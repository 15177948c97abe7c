// What mihost says about its properties and methods, read once.
import * as mihost from "./mihost.js";

function once(words, index) {
    let answer = null;
    return () => {
        if (!answer) {
            answer = mihost.json(words).answer.then(index);
            answer.catch(() => { answer = null; });
        }
        return answer;
    };
}

/** Keyed by kind of node: its meaning, and its properties keyed by name. */
export const properties = once(["properties"], kinds => new Map(kinds.map(kind => [kind.kind, {
    meaning: kind.meaning,
    properties: new Map(kind.properties.map(property => [property.name, property])),
}])));

/** Keyed by method: its parameters, keyed by name. */
export const methods = once(["methods"], list => new Map(list.map(method => [method.method, {
    meaning: method.meaning,
    parameters: new Map(method.parameters.map(parameter => [parameter.name, parameter])),
}])));
