// What leaves the page: text into the clipboard, files into the visitor's downloads.

// On plain HTTP there is no clipboard, and a visitor may refuse.
export async function copy(text: string): Promise<boolean> {
    return (await navigator.clipboard?.writeText(text).then(() => true, () => false)) ?? false;
}

export function download(file: Blob, name: string): void {
    const link = document.createElement('a');
    link.href = URL.createObjectURL(file);
    link.download = name;
    link.click();
    setTimeout(() => URL.revokeObjectURL(link.href), 10_000);
}
