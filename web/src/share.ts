// Copies text to the clipboard and saves files.

// False without a clipboard, as on plain HTTP, or without the visitor's permission.
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
