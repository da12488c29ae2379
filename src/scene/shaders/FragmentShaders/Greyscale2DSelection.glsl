// The id of a patch, where it is not black.
uniform sampler2D t_Texture;
uniform vec3 u_SelectionId;

varying vec2 v_UV;

void main()
{
	if (texture2D(t_Texture, v_UV).r < 0.5 / 255.0)
		discard;
	gl_FragColor = vec4(u_SelectionId, 1.0 / 255.0);
}
